#include "objectmanager/model/Schema.h"

#include <gtest/gtest.h>

#include <set>

namespace om {
namespace {

TEST(SchemaTest, NamesCompareWithoutRegardToCase) {
    const Schema& schema = Schema::builtin();
    ASSERT_NE(schema.find("veska_COMPUTERsystem"), nullptr);
    EXPECT_EQ(schema.find("veska_COMPUTERsystem")->name, "VESKA_ComputerSystem");
    EXPECT_EQ(schema.findProperty("veska_computersystem", "operationalSTATUS")->type, CMPI_uint16A);
    EXPECT_EQ(schema.find("VESKA_"), nullptr);
    EXPECT_EQ(schema.find(""), nullptr);
}

TEST(SchemaTest, IsAGoesUpTheLineOfInheritance) {
    const Schema& schema = Schema::builtin();
    EXPECT_TRUE(schema.isA("VESKA_TimeService", "cim_managedelement"));
    EXPECT_TRUE(schema.isA("VESKA_TimeService", "VESKA_TimeService"));
    EXPECT_TRUE(schema.isA("VESKA_ComputerSystemPackage", "CIM_Dependency"));
    EXPECT_FALSE(schema.isA("CIM_Service", "VESKA_TimeService"));
    EXPECT_FALSE(schema.isA("VESKA_TimeService", "CIM_System"));
    EXPECT_FALSE(schema.isA("Unknown", "Unknown"));
    EXPECT_FALSE(schema.isA("VESKA_TimeService", ""));
}

std::set<std::string> keysOf(const char* className) {
    std::set<std::string> keys;
    for (const PropertyDeclaration* key : Schema::builtin().resolve(className)->keys) keys.insert(key->name);
    return keys;
}

TEST(SchemaTest, KeysAreInheritedOrOverridden) {
    using Names = std::set<std::string>;
    EXPECT_EQ(keysOf("VESKA_EnabledLogicalElementCapabilities"), (Names{"InstanceID"}));
    EXPECT_EQ(keysOf("VESKA_TimeService"),
              (Names{"CreationClassName", "Name", "SystemCreationClassName", "SystemName"}));
    EXPECT_EQ(keysOf("VESKA_ComputerSystemPackage"), (Names{"Antecedent", "Dependent"}));
}

TEST(SchemaTest, ServesTheClassesAndThenTheAssociationsThatAreNotTheStandards) {
    using List = std::vector<std::string>;
    const Schema schema({{"CIM_Top", "", false, {}, {}},
                         {"X_Link", "", true, {}, {}},
                         {"X_Thing", "CIM_Top", false, {}, {}},
                         {"cim_Link", "", true, {}, {}},
                         {"A", "CIM_Top", false, {}, {}}});
    EXPECT_EQ(schema.servedClasses(), (List{"X_Thing", "A"}));
    EXPECT_EQ(schema.servedAssociations(), (List{"X_Link"}));
    EXPECT_EQ(schema.served(), (List{"X_Thing", "A", "X_Link"}));
}

TEST(SchemaTest, ServedBelowAClassAreItselfAndWhatDerivesFromIt) {
    using List = std::vector<std::string>;
    Schema schema({{"X_Thing", "CIM_Top", false, {}, {}}, {"CIM_Top", "", false, {}, {}}});
    schema.add({"X_Link", "CIM_Top", true, {}, {}});
    schema.add({"X_Better", "X_Thing", false, {}, {}});
    EXPECT_EQ(schema.servedBelow("cim_top"), (List{"X_Thing", "X_Better", "X_Link"}));
    EXPECT_EQ(schema.servedBelow("X_Thing"), (List{"X_Thing", "X_Better"}));
    EXPECT_EQ(schema.servedBelow("X_Link"), (List{"X_Link"}));
    EXPECT_EQ(schema.servedBelow("Unknown"), List());
    const Schema circle({{"A", "A", false, {}, {}}, {"B", "", false, {}, {}}});
    EXPECT_EQ(circle.servedBelow("A"), (List{"A"}));
}

TEST(SchemaTest, TheNearestDeclarationCounts) {
    const Schema& schema = Schema::builtin();
    EXPECT_EQ(schema.findProperty("VESKA_ComputerSystemPackage", "Antecedent")->referenceClass,
              "VESKA_PhysicalPackage");
    EXPECT_EQ(schema.findProperty("CIM_ComputerSystemPackage", "Antecedent")->referenceClass, "CIM_PhysicalPackage");
    EXPECT_EQ(schema.findProperty("CIM_SystemPackaging", "Antecedent")->referenceClass, "CIM_PhysicalElement");
    EXPECT_FALSE(schema.findProperty("CIM_ManagedElement", "InstanceID")->key);
    EXPECT_TRUE(schema.findProperty("CIM_Capabilities", "InstanceID")->key);
}

TEST(SchemaTest, PropertiesOfOurOwnClasses) {
    const Schema& schema = Schema::builtin();
    EXPECT_EQ(schema.findProperty("VESKA_ComputerSystem", "UUID")->type, CMPI_string);
    EXPECT_EQ(schema.findProperty("CIM_ComputerSystem", "UUID"), nullptr);
    EXPECT_EQ(schema.findProperty("VESKA_EnabledLogicalElementCapabilities", "StateAwareness")->type, CMPI_uint16A);
    EXPECT_EQ(schema.findProperty("VESKA_TimeService", "AutomaticDSTAdjustment")->type, CMPI_boolean);
    EXPECT_EQ(schema.findProperty("VESKA_TimeService", "Region")->type, CMPI_string);
    EXPECT_EQ(schema.findProperty("VESKA_CIMServiceConfig", "deliveryRetryIntervalSec")->type, CMPI_uint32);
}

TEST(SchemaTest, MethodsAreInheritedWithTheirParameters) {
    const MethodDeclaration* manage = Schema::builtin().findMethod("VESKA_TimeService", "managetime");
    ASSERT_NE(manage, nullptr);
    ASSERT_EQ(manage->parameters.size(), 3U);
    EXPECT_EQ(manage->parameters[1].type, CMPI_dateTime);
    EXPECT_TRUE(manage->parameters[1].in && manage->parameters[1].out);
    EXPECT_TRUE(manage->parameters[2].in && !manage->parameters[2].out);
    EXPECT_EQ(manage->parameters[2].referenceClass, "CIM_ManagedElement");
    EXPECT_NE(Schema::builtin().findMethod("VESKA_TimeService", "StopService"), nullptr);
    EXPECT_EQ(Schema::builtin().findMethod("VESKA_CIMServiceConfig", "SetCIMconfig")->parameters.size(), 2U);
    EXPECT_EQ(Schema::builtin().findMethod("VESKA_ComputerSystem", "ManageTime"), nullptr);
}

TEST(SchemaTest, EverySuperclassAndClassReferredToIsThere) {
    const Schema& schema = Schema::builtin();
    for (const ClassDeclaration& each : schema.classes()) {
        EXPECT_TRUE(each.superclass.empty() || schema.find(each.superclass) != nullptr) << each.name;
        for (const PropertyDeclaration& property : each.properties) {
            EXPECT_EQ(property.type == CMPI_ref, schema.find(property.referenceClass) != nullptr) << property.name;
        }
    }
    EXPECT_GT(schema.classes().size(), schema.served().size());
    EXPECT_FALSE(schema.served().empty());
}

TEST(SchemaTest, ThePropertiesOfAClassHaveWords) {
    const Schema& schema = Schema::builtin();
    const Value two{CMPI_uint16, std::uint64_t{2}};
    using Words = std::vector<std::string_view>;
    EXPECT_EQ(schema.wordsFor("veska_physicalpackage", {"packagetype", two}), Words{"Rack"});
    EXPECT_EQ(schema.wordsFor("VESKA_PhysicalPackage", {"Unknown", two}), Words());
    EXPECT_EQ(schema.wordsFor("Unknown", {"PackageType", two}), Words());
}

TEST(SchemaTest, TheLineOfInheritanceStartsAtTheClassItself) {
    const auto names = [](const char* className) {
        std::vector<std::string> list;
        for (const ClassDeclaration* each : Schema::builtin().line(className)) list.push_back(each->name);
        return list;
    };
    EXPECT_EQ(names("veska_computersystempackage"),
              (std::vector<std::string>{"VESKA_ComputerSystemPackage", "CIM_ComputerSystemPackage",
                                        "CIM_SystemPackaging", "CIM_Dependency"}));
    EXPECT_EQ(names("Unknown"), std::vector<std::string>());
}

TEST(SchemaTest, AClassThatIsItsOwnAncestorEndsNoWalk) {
    const Schema circle({{"A", "B", false, {}, {}}, {"B", "A", false, {}, {}}});
    EXPECT_EQ(circle.line("A").size(), 2U);
    EXPECT_TRUE(circle.isA("A", "B"));
    EXPECT_FALSE(circle.isA("A", "C"));
}

} // namespace
} // namespace om
