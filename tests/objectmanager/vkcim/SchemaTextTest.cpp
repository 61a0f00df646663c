#include "objectmanager/vkcim/SchemaText.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::Eq;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

std::string described(const char* className) {
    const om::Schema& schema = om::Schema::builtin();
    return classText(*schema.find(className), schema);
}

TEST(SchemaText, ListsTheClassesWithKindAndSuperclass) {
    const std::string text = classesText(om::Schema::builtin());
    EXPECT_THAT(text, StartsWith("VESKA_ComputerSystem                     class        CIM_ComputerSystem\n"));
    EXPECT_THAT(text, HasSubstr("\nVESKA_TimeServiceAffectsElement          association  CIM_ServiceAffectsElement\n"));
    EXPECT_THAT(text, Not(HasSubstr("\nCIM_")));
}

TEST(SchemaText, DescribesPropertiesWithTypeMarksAndWords) {
    const std::string computer = described("VESKA_ComputerSystem");
    EXPECT_THAT(computer,
                StartsWith("VESKA_ComputerSystem: class derived from CIM_ComputerSystem\n  The host computer."));
    EXPECT_THAT(computer, HasSubstr("\n  Name: string, key\n      The kernel's node name, as gethostname"));
    EXPECT_THAT(computer, HasSubstr("\n  OperationalStatus: uint16[]\n"));
    EXPECT_THAT(computer, HasSubstr("\n      0 Unknown, 2 OK, 3 Degraded, 5 Predictive Failure, 11 In Service\n"));
    EXPECT_THAT(computer, Not(HasSubstr("OK OK"))) << "strings that are their own words";
    EXPECT_THAT(computer, Not(HasSubstr("\nMethods\n")));
    EXPECT_THAT(described("VESKA_TimeService"), HasSubstr("\n  AutomaticDSTAdjustment: boolean, writable\n"));
    EXPECT_THAT(described("VESKA_ComputerCapabilities"),
                HasSubstr("\n  ManagedElement: ref to VESKA_ComputerSystem, key\n      The computer system.\n"));
}

TEST(SchemaText, DescribesMethodsWithTheirParameters) {
    const std::string service = described("VESKA_TimeService");
    EXPECT_THAT(service, HasSubstr("\nMethods\n  ManageTime(): uint32\n      Reads or sets the host's time."));
    EXPECT_THAT(service, HasSubstr("\n    TimeData: datetime, in and out\n      The time to set"));
    EXPECT_THAT(service, HasSubstr("\n    ManagedElement: ref to CIM_ManagedElement, in\n"));
    EXPECT_THAT(service, HasSubstr("\nInherited methods, not offered here\n  StartService, StopService\n"));
    EXPECT_THAT(
        service,
        HasSubstr(
            "\nInherited properties, not supplied here\n  PrimaryOwnerName, PrimaryOwnerContact, StartMode, Started, "
            "EnabledState,"));
}

TEST(SchemaText, DescribesAClassOfTheStandardByItsNames) {
    EXPECT_THAT(described("CIM_ElementCapabilities"), Eq(R"(CIM_ElementCapabilities: association

Properties
  ManagedElement: ref to CIM_ManagedElement, key
  Capabilities: ref to CIM_Capabilities, key
  Characteristics: uint16[]

Classes derived from it
  VESKA_ComputerCapabilities
)"));
}

} // namespace
} // namespace vkcim
