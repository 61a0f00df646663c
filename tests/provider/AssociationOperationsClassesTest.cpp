// Which associations a class stands for.
#include "provider/BaseServerProvider.h"
#include "support/Provider.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using namespace VK::BaseServerProvider;

/// The built-in schema with one more class above the three associations, and one below two of them that has no
/// relation to the third.
om::Schema schemaWithCommonAncestor() {
    const auto& builtin = om::Schema::builtin().classes();
    std::vector<om::ClassDeclaration> classes(builtin.begin(), builtin.end());
    for (om::ClassDeclaration& each : classes)
        if (each.name == "CIM_ElementCapabilities" || each.name == "CIM_ComputerSystemPackage" ||
            each.name == "CIM_ServiceAffectsElement")
            each.superclass = "Test_AnyAssociation";
    om::ClassDeclaration any;
    any.name = "Test_AnyAssociation";
    any.association = true;
    classes.push_back(any);
    om::ClassDeclaration derived;
    derived.name = "Test_OtherPackage";
    derived.superclass = "CIM_ComputerSystemPackage";
    derived.association = true;
    classes.push_back(derived);
    return om::Schema(classes);
}

class ClassResolution : public testing::Test {
protected:
    ClassResolution() { broker = manager.broker(); }
    ~ClassResolution() override { broker = nullptr; }

    static std::vector<unsigned short> resolve(const char* className) {
        std::vector<unsigned short> ids;
        const bool found = getClassId(className, "root/cimv2", ids);
        EXPECT_EQ(found, !ids.empty());
        return ids;
    }

    const om::Schema schema = schemaWithCommonAncestor();
    om::ObjectManager manager{VK_PROVIDER_LIBRARY, "BaseServerProvider", "root/cimv2", schema};
};

TEST_F(ClassResolution, AnswersTheClassTablesNumberAlone) {
    EXPECT_THAT(resolve("VESKA_ComputerCapabilities"), ElementsAre(33));
    EXPECT_THAT(resolve("VESKA_ComputerSystemPackage"), ElementsAre(24));
    EXPECT_THAT(resolve("VESKA_TimeServiceAffectsElement"), ElementsAre(162));
    EXPECT_THAT(resolve("VESKA_ComputerSystem"), ElementsAre(1));
}

TEST_F(ClassResolution, TakesRelativesOfAnAssociationForIt) {
    EXPECT_THAT(resolve("CIM_ElementCapabilities"), ElementsAre(33));
    EXPECT_THAT(resolve("CIM_ComputerSystemPackage"), ElementsAre(24));
    EXPECT_THAT(resolve("CIM_ServiceAffectsElement"), ElementsAre(162));
    EXPECT_THAT(resolve("Test_OtherPackage"), ElementsAre(24));
}

TEST_F(ClassResolution, AnswersSeveralNumbersInTheOrderOfTheTable) {
    EXPECT_THAT(resolve("Test_AnyAssociation"), ElementsAre(33, 24, 162));
}

TEST_F(ClassResolution, FindsNothingForUnrelatedOrUnknownNames) {
    EXPECT_THAT(resolve("CIM_ComputerSystem"), IsEmpty());
    EXPECT_THAT(resolve("NoSuchClass"), IsEmpty());
}

TEST_F(ClassResolution, TakesNoNameForAllAssociations) {
    EXPECT_THAT(resolve(nullptr), ElementsAre(33, 24, 162));
    EXPECT_THAT(resolve(""), ElementsAre(33, 24, 162));
}

TEST_F(ClassResolution, AppendsToWhatIsThere) {
    std::vector<unsigned short> ids = {7};
    EXPECT_TRUE(getClassId("CIM_ElementCapabilities", "root/cimv2", ids));
    EXPECT_THAT(ids, ElementsAre(7, 33));
}

} // namespace
