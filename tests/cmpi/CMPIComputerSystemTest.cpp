#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <cstdint>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

constexpr char className[] = "VESKA_ComputerSystem";

om::ObjectPath named(const std::string& name) {
    return test::path(className, {{"CreationClassName", className}, {"Name", name}});
}

std::vector<std::string> namesIn(const om::Answer& answer) {
    std::vector<std::string> names;
    for (const om::Instance& instance : test::instancesOf(answer)) {
        const om::Value* name = test::find(instance.properties, "Name");
        names.push_back(name == nullptr ? "(none)" : test::text(*name));
    }
    return names;
}

/// The one computer that the host has, changed by `change`.
template <class Change>
om::Instance onlyInstance(Change change) {
    test::Node node = test::computer(0, "node7");
    change(node);
    test::simulate({node, test::chassis(0, 0, "CZ1")});
    const std::vector<om::Instance> found = test::instancesOf(test::instances(className));
    if (found.size() != 1) throw std::runtime_error("not one instance");
    return found.front();
}

std::vector<std::string> textsOf(const om::Instance& instance, const std::string& name) {
    std::vector<std::string> texts;
    const om::Value* const value = test::find(instance.properties, name);
    if (value == nullptr) return texts;
    EXPECT_EQ(value->type, CMPI_stringA) << name;
    for (const om::Value& element : std::get<std::vector<om::Value>>(value->data)) texts.push_back(test::text(element));
    return texts;
}

std::vector<std::uint64_t> numbersOf(const om::Instance& instance, const std::string& name) {
    std::vector<std::uint64_t> numbers;
    const om::Value* const value = test::find(instance.properties, name);
    if (value == nullptr) return numbers;
    if (value->type == CMPI_uint16) return {std::get<std::uint64_t>(value->data)};
    EXPECT_EQ(value->type, CMPI_uint16A) << name;
    for (const om::Value& element : std::get<std::vector<om::Value>>(value->data))
        numbers.push_back(std::get<std::uint64_t>(element.data));
    return numbers;
}

TEST(CMPIComputerSystem, NamesEveryComputerByClassAndNameInThisOrder) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8"), test::chassis(0, 0, "CZ1")});
    const om::Answer answer = test::names(className);
    const std::vector<om::ObjectPath> paths = test::paths(answer);
    ASSERT_THAT(paths, SizeIs(2));
    EXPECT_EQ(test::print(paths[0]), "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"node7\"");
    EXPECT_EQ(test::print(paths[1]), "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"node8\"");
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

TEST(CMPIComputerSystem, LeavesTheNameKeyOutWhereTheComputerHasNone) {
    test::Node nameless = test::computer(0, "");
    nameless.properties.erase(108);
    test::simulate({nameless});
    const std::vector<om::ObjectPath> paths = test::paths(test::names(className));
    ASSERT_THAT(paths, SizeIs(1));
    EXPECT_EQ(test::print(paths[0]), "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\"");
}

TEST(CMPIComputerSystem, AnswersInTheNamespaceAskedFor) {
    test::simulate({test::computer(0, "node7")});
    om::Request request;
    request.operation = om::Operation::EnumInstances;
    request.path = test::path(className);
    request.path.nameSpace = "root/other";
    const std::vector<om::Instance> found = test::instancesOf(test::provider().run(request));
    ASSERT_THAT(found, SizeIs(1));
    EXPECT_EQ(found[0].path.nameSpace, "root/other");
}

TEST(CMPIComputerSystem, SetsItsPropertiesInOrder) {
    const om::Instance instance = onlyInstance([](test::Node& node) {
        node.properties[115] = "ops@example.org";
        node.properties[116] = "Operations";
    });
    EXPECT_THAT(test::namesOf(instance.properties),
                ElementsAre("Description", "ElementName", "OperationalStatus", "HealthState", "EnabledState",
                            "CreationClassName", "Name", "PrimaryOwnerName", "PrimaryOwnerContact",
                            "OtherIdentifyingInfo", "IdentifyingDescriptions", "Dedicated", "UUID", "Status"));
}

TEST(CMPIComputerSystem, SetsTheValuesOfTheHost) {
    const om::Instance instance = onlyInstance([](test::Node& node) {
        node.properties[115] = "ops@example.org";
        node.properties[116] = "Operations";
    });
    const std::pair<const char*, const char*> texts[] = {
        {"Description", "Rack server 0"},
        {"ElementName", "node7"},
        {"CreationClassName", className},
        {"Name", "node7"},
        {"PrimaryOwnerName", "Operations"},
        {"PrimaryOwnerContact", "ops@example.org"},
        {"UUID", "4c4c4544-0043-3010-8052-000000000000"},
        {"Status", "OK"},
    };
    for (const auto& [name, expected] : texts) {
        const om::Value* const value = test::find(instance.properties, name);
        ASSERT_NE(value, nullptr) << name;
        EXPECT_EQ(value->type, CMPI_string) << name;
        EXPECT_EQ(test::text(*value), expected) << name;
    }
    EXPECT_THAT(numbersOf(instance, "OperationalStatus"), ElementsAre(2, 11));
    EXPECT_THAT(numbersOf(instance, "HealthState"), ElementsAre(5));
    EXPECT_THAT(numbersOf(instance, "EnabledState"), ElementsAre(2));
    EXPECT_THAT(numbersOf(instance, "Dedicated"), ElementsAre(0));
    EXPECT_EQ(test::find(instance.properties, "Dedicated")->type, CMPI_uint16A);
}

TEST(CMPIComputerSystem, IdentifiesTheComputerPairByPair) {
    const om::Instance instance = onlyInstance([](test::Node&) {});
    EXPECT_THAT(textsOf(instance, "OtherIdentifyingInfo"),
                ElementsAre("4c4c4544-0043-3010-8052-000000000000", "uid-1", "Model 0:SYS0", "SYS0", "x86_64", "true"));
    EXPECT_THAT(textsOf(instance, "IdentifyingDescriptions"),
                ElementsAre("CIM:GUID", "CIM:UniqueSystemID", "CIM:Model:SerialNumber", "CIM:Tag", "CIM:Architecture",
                            "CIM:SecureIndicationEnabled"));
}

TEST(CMPIComputerSystem, SetsNeitherIdentifyingPropertyWithoutAChassis) {
    test::simulate({test::computer(0, "node7")});
    const std::vector<om::Instance> found = test::instancesOf(test::instances(className));
    ASSERT_THAT(found, SizeIs(1));
    EXPECT_EQ(test::find(found[0].properties, "OtherIdentifyingInfo"), nullptr);
    EXPECT_EQ(test::find(found[0].properties, "IdentifyingDescriptions"), nullptr);
    EXPECT_NE(test::find(found[0].properties, "UUID"), nullptr);
}

TEST(CMPIComputerSystem, NeverSetsWhatTheHostCannotSupply) {
    const om::Instance instance = onlyInstance([](test::Node&) {});
    for (const char* name :
         {"Caption", "InstallDate", "StatusDescriptions", "PrimaryStatus", "DetailedStatus", "OperatingStatus",
          "CommunicationStatus", "OtherEnabledState", "RequestedState", "EnabledDefault", "TimeOfLastStateChange",
          "AvailableRequestedStates", "TransitioningToState", "Roles", "NameFormat", "OtherDedicatedDescriptions",
          "ResetCapability"})
        EXPECT_EQ(test::find(instance.properties, name), nullptr) << name;
}

TEST(CMPIComputerSystem, LeavesUnsetWhatThisHostDoesNotKnow) {
    const om::Instance instance = onlyInstance([](test::Node& node) { node.properties.clear(); });
    EXPECT_THAT(test::namesOf(instance.properties),
                ElementsAre("Description", "OperationalStatus", "HealthState", "CreationClassName",
                            "OtherIdentifyingInfo", "IdentifyingDescriptions", "Dedicated", "Status"));
}

TEST(CMPIComputerSystem, PublishesAnUnknownPowerStateAsEnabledStateZero) {
    const om::Instance instance = onlyInstance([](test::Node& node) { node.properties[123] = 7; });
    EXPECT_THAT(numbersOf(instance, "EnabledState"), ElementsAre(0));
}

TEST(CMPIComputerSystem, DoesNotDoubleTheOperationalStatusFromComputerToComputer) {
    test::Node failing = test::computer(1, "node8");
    failing.status = 20;
    test::simulate({test::computer(0, "node7"), failing, test::computer(2, "node9")});
    const std::vector<om::Instance> found = test::instancesOf(test::instances(className));
    ASSERT_THAT(found, SizeIs(3));
    EXPECT_THAT(numbersOf(found[0], "OperationalStatus"), ElementsAre(2, 11));
    EXPECT_THAT(numbersOf(found[1], "OperationalStatus"), ElementsAre(3, 5));
    EXPECT_THAT(numbersOf(found[2], "OperationalStatus"), ElementsAre(2, 11));
    EXPECT_THAT(numbersOf(found[2], "Dedicated"), ElementsAre(0));
}

TEST(CMPIComputerSystem, SetsEveryPropertyWhateverTheListSays) {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1")});
    const std::vector<std::string> all = test::namesOf(test::instancesOf(test::instances(className)).at(0).properties);
    const std::vector<std::vector<std::string>> lists = {{}, {"Name"}, {"Caption", "NoSuchProperty"}};
    for (const std::vector<std::string>& list : lists) {
        om::Request request;
        request.operation = om::Operation::GetInstance;
        request.path = named("node7");
        request.propertyList = list;
        const std::vector<om::Instance> found = test::instancesOf(test::provider().run(request));
        ASSERT_THAT(found, SizeIs(1));
        EXPECT_EQ(test::namesOf(found[0].properties), all);
    }
}

TEST(CMPIComputerSystem, GetsTheComputerNamed) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    const om::Answer answer = test::get(named("node8"));
    EXPECT_THAT(namesIn(answer), ElementsAre("node8"));
    EXPECT_EQ(test::text(*test::find(test::instancesOf(answer)[0].properties, "CreationClassName")), className);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

TEST(CMPIComputerSystem, ComparesTheNameExactly) {
    test::simulate({test::computer(0, "node7")});
    for (const char* other : {"NODE7", "node", "node77", "", "node7 "}) {
        const om::Answer answer = test::get(named(other));
        EXPECT_THAT(answer.results, IsEmpty()) << "'" << other << "'";
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        EXPECT_TRUE(answer.done);
    }
}

TEST(CMPIComputerSystem, TakesTheKeyNamesInAnyCase) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    EXPECT_THAT(namesIn(test::get(test::path(className, {{"name", "node8"}}))), ElementsAre("node8"));
    EXPECT_THAT(namesIn(test::get(test::path(className, {{"NAME", "node7"}}))), ElementsAre("node7"));
}

TEST(CMPIComputerSystem, DoesNotCheckTheCreationClassName) {
    test::simulate({test::computer(0, "node7")});
    EXPECT_THAT(namesIn(test::get(test::path(className, {{"CreationClassName", "Other"}, {"Name", "node7"}}))),
                ElementsAre("node7"));
}

TEST(CMPIComputerSystem, GetsEveryComputerForAPathWithoutKeys) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    const om::Answer answer = test::get(test::path(className));
    EXPECT_THAT(namesIn(answer), ElementsAre("node7", "node8"));
    EXPECT_TRUE(answer.done);
}

TEST(CMPIComputerSystem, GetsEveryComputerForAPathWithoutTheNameKey) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    EXPECT_THAT(namesIn(test::get(test::path(className, {{"CreationClassName", className}}))),
                ElementsAre("node7", "node8"));
    EXPECT_THAT(namesIn(test::get(test::path(className, {{"Tag", "CZ1"}}))), ElementsAre("node7", "node8"));
}

TEST(CMPIComputerSystem, TakesANameThatIsNoTextForAbsent) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    om::ObjectPath path = test::path(className);
    path.keys.push_back({"Name", {CMPI_uint64, std::uint64_t{7}}});
    EXPECT_THAT(namesIn(test::get(path)), ElementsAre("node7", "node8"));
}

TEST(CMPIComputerSystem, NarrowsEnumerationsToo) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    om::Request request;
    request.operation = om::Operation::EnumInstanceNames;
    request.path = named("node8");
    EXPECT_THAT(test::paths(test::provider().run(request)), SizeIs(1));
}

TEST(CMPIComputerSystem, ReturnsNothingForAHostWithoutAComputer) {
    test::simulate({test::chassis(0, 0, "CZ1")});
    for (const om::Answer& answer : {test::names(className), test::instances(className), test::get(named("node7"))}) {
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        EXPECT_THAT(answer.results, IsEmpty());
        EXPECT_TRUE(answer.done);
    }
}

TEST(CMPIComputerSystem, SeesTheHostAsItStandsAtEachRequest) {
    test::simulate({test::computer(0, "node7")});
    EXPECT_THAT(namesIn(test::instances(className)), ElementsAre("node7"));
    test::simulate({test::computer(0, "renamed")});
    EXPECT_THAT(namesIn(test::instances(className)), ElementsAre("renamed"));
}

TEST(CMPIComputerSystem, KeepsTextsOfAnyLengthAndBytes) {
    const std::string longName(4000, 'n');
    const om::Instance instance = onlyInstance([&](test::Node& node) {
        node.properties[108] = longName;
        node.description = "Rück \"server\" \\ \xE2\x82\xAC";
    });
    EXPECT_EQ(test::text(*test::find(instance.properties, "Name")), longName);
    EXPECT_EQ(test::text(*test::find(instance.properties, "Description")), "Rück \"server\" \\ \xE2\x82\xAC");
    EXPECT_THAT(namesIn(test::get(named(longName))), ElementsAre(longName));
}

} // namespace
