#include "objectmanager/vkcim/Advice.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

const om::Schema& schema() {
    return om::Schema::builtin();
}

om::Request request(om::Operation operation, const char* className, std::vector<om::NamedValue> values = {}) {
    om::Request made;
    made.operation = operation;
    made.path.className = className;
    made.values = std::move(values);
    return made;
}

om::Request call(const char* className, const char* method, std::vector<om::NamedValue> arguments = {}) {
    om::Request made = request(om::Operation::InvokeMethod, className, std::move(arguments));
    made.method = method;
    return made;
}

const om::Value yes{CMPI_boolean, true};
const om::Value text{CMPI_string, std::string("a")};

TEST(Advice, NamesPropertiesThatTheClassLacksOrThatAreNotWritable) {
    EXPECT_THAT(
        remarksOn(request(om::Operation::ModifyInstance, "veska_timeservice",
                          {{"automaticdstadjustment", yes}, {"Region", text}, {"Regoin", yes}, {"Zzzzzzzz", yes}}),
                  schema()),
        ElementsAre("Region of VESKA_TimeService is not writable",
                    "VESKA_TimeService has no property Regoin; did you mean Region?",
                    "VESKA_TimeService has no property Zzzzzzzz"));
    EXPECT_THAT(
        remarksOn(request(om::Operation::CreateInstance, "VESKA_ComputerSystem", {{"Name", text}, {"Nmae", yes}}),
                  schema()),
        ElementsAre("VESKA_ComputerSystem has no property Nmae; did you mean Name?"));
}

TEST(Advice, NamesTypesThatAreNotTheDeclaredOnes) {
    EXPECT_THAT(
        remarksOn(request(om::Operation::ModifyInstance, "VESKA_TimeService", {{"automaticdstadjustment", text}}),
                  schema()),
        ElementsAre("AutomaticDSTAdjustment of VESKA_TimeService is boolean, not string"));
    EXPECT_THAT(
        remarksOn(call("VESKA_TimeService", "ManageTime", {{"getrequest", {CMPI_uint8, std::uint64_t{1}}}}), schema()),
        ElementsAre("GetRequest of ManageTime is boolean, not uint8"));
}

TEST(Advice, NamesThePropertyWhoseValueWasWanted) {
    EXPECT_EQ(remarkOnProperty("veska_physicalpackage", "SeralNumber", schema()),
              "VESKA_PhysicalPackage has no property SeralNumber; did you mean SerialNumber?");
    EXPECT_EQ(remarkOnProperty("VESKA_PhysicalPackage", "serialnumber", schema()), "");
    EXPECT_EQ(remarkOnProperty("Other_Class", "SeralNumber", schema()), "");
}

TEST(Advice, SaysNothingOfClassesThatItDoesNotKnow) {
    EXPECT_THAT(remarksOn(request(om::Operation::ModifyInstance, "Other_Class", {{"A", yes}}), schema()), IsEmpty());
    EXPECT_THAT(remarksOn(call("Other_Class", "Run"), schema()), IsEmpty());
    EXPECT_THAT(remarksOn(request(om::Operation::GetInstance, "VESKA_TimeService"), schema()), IsEmpty());
}

TEST(Advice, NamesTheMethodsOfAClass) {
    EXPECT_THAT(remarksOn(call("VESKA_TimeService", "SetClock"), schema()),
                ElementsAre("VESKA_TimeService has no method SetClock; its methods: ManageTime"));
    EXPECT_THAT(remarksOn(call("VESKA_TimeService", "MangeTime"), schema()),
                ElementsAre("VESKA_TimeService has no method MangeTime; did you mean ManageTime?"));
    EXPECT_THAT(remarksOn(call("VESKA_ComputerSystem", "Reboot"), schema()),
                ElementsAre("VESKA_ComputerSystem has no method Reboot; it has none"));
    EXPECT_THAT(remarksOn(call("VESKA_TimeService", "StopService"), schema()), IsEmpty());
    EXPECT_THAT(adviceOn(call("VESKA_TimeService", "StopService"), CMPI_RC_ERR_INVALID_PARAMETER, schema()),
                ElementsAre("VESKA_TimeService inherits StopService; its own methods: ManageTime"));
}

TEST(Advice, NamesTheParametersOfAMethodWithTheirTypes) {
    EXPECT_THAT(remarksOn(call("VESKA_TimeService", "managetime", {{"getrequest", yes}, {"GetReqest", yes}}), schema()),
                ElementsAre("ManageTime has no parameter GetReqest; did you mean GetRequest?"));
    EXPECT_THAT(adviceOn(call("VESKA_TimeService", "ManageTime", {{"ManagedElement", yes}}),
                         CMPI_RC_ERR_INVALID_PARAMETER, schema()),
                ElementsAre("ManageTime takes GetRequest (boolean, in), TimeData (datetime, in and out), "
                            "ManagedElement (ref to CIM_ManagedElement, in)",
                            "not given: GetRequest, TimeData"));
    EXPECT_THAT(adviceOn(call("VESKA_TimeService", "ManageTime"), CMPI_RC_ERR_FAILED, schema()), IsEmpty());
    EXPECT_THAT(adviceOn(call("VESKA_TimeService", "Unknown"), CMPI_RC_ERR_METHOD_NOT_FOUND, schema()), IsEmpty())
        << "that was said before";
}

std::vector<std::string> adviceOnNames(const char* className) {
    return adviceOn(request(om::Operation::EnumInstanceNames, className), CMPI_RC_ERR_INVALID_CLASS, schema());
}

TEST(Advice, NamesTheClassesBelowOneThatIsNotServed) {
    EXPECT_THAT(adviceOnNames("cim_computersystem"),
                ElementsAre("ask for a class below CIM_ComputerSystem: VESKA_ComputerSystem"));
    EXPECT_THAT(adviceOnNames("CIM_Dependency"),
                ElementsAre("ask for a class below CIM_Dependency: VESKA_ComputerSystemPackage"));
    EXPECT_THAT(adviceOnNames("VESKA_TimeSevice"),
                ElementsAre("there is no class VESKA_TimeSevice; did you mean VESKA_TimeService?"));
    EXPECT_THAT(adviceOnNames("Something_Else"), ElementsAre("there is no class Something_Else in the schema"));
    EXPECT_THAT(adviceOnNames("VESKA_TimeService"), IsEmpty());
}

TEST(Advice, NamesTheAssociationClassThatMayBeMissing) {
    om::Request asked = request(om::Operation::Associators, "VESKA_ComputerSystem");
    EXPECT_THAT(adviceOn(asked, CMPI_RC_ERR_INVALID_CLASS, schema()),
                ElementsAre("the association's class may have to be named: --assoc-class"));
    asked.assocClass = "VESKA_ComputerCapabilites";
    EXPECT_THAT(adviceOn(asked, CMPI_RC_ERR_INVALID_CLASS, schema()),
                ElementsAre("there is no class VESKA_ComputerCapabilites; did you mean VESKA_ComputerCapabilities?"));
    asked.assocClass = "VESKA_TimeService";
    EXPECT_THAT(adviceOn(asked, CMPI_RC_ERR_INVALID_CLASS, schema()), IsEmpty());
    EXPECT_THAT(adviceOn(asked, CMPI_RC_ERR_NOT_SUPPORTED, schema()), IsEmpty());
}

} // namespace
} // namespace vkcim
