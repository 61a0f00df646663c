#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <cstdint>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
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

TEST(CMPIComputerSystem, NamesEveryComputerByClassAndByItsNameWhereItHasOne) {
    test::simulate({test::computer(0, "node7"), test::without(test::computer(1, ""), 108)});
    const om::Answer answer = test::names(className);
    EXPECT_THAT(test::printed(answer),
                ElementsAre("VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"node7\"",
                            "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\""));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

TEST(CMPIComputerSystem, AnswersInTheNamespaceAskedFor) {
    test::simulate({test::computer(0, "node7")});
    om::Request request = test::asking(om::Operation::EnumInstances, test::path(className));
    request.path.nameSpace = "root/other";
    const std::vector<om::Instance> found = test::instancesOf(test::provider().run(request));
    ASSERT_THAT(found, SizeIs(1));
    EXPECT_EQ(found[0].path.nameSpace, "root/other");
}

TEST(CMPIComputerSystem, SetsTheValuesOfTheHostInOrder) {
    const om::Instance instance = onlyInstance([](test::Node& node) {
        node.properties[115] = "ops@example.org";
        node.properties[116] = "Operations";
    });
    EXPECT_THAT(test::namesOf(instance.properties),
                ElementsAre("Description", "ElementName", "OperationalStatus", "HealthState", "EnabledState",
                            "CreationClassName", "Name", "PrimaryOwnerName", "PrimaryOwnerContact",
                            "OtherIdentifyingInfo", "IdentifyingDescriptions", "Dedicated", "UUID", "Status"));
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
    EXPECT_THAT(textsOf(instance, "OtherIdentifyingInfo"),
                ElementsAre("4c4c4544-0043-3010-8052-000000000000", "uid-1", "Model 0:SYS0", "SYS0", "x86_64", "true"));
    EXPECT_THAT(textsOf(instance, "IdentifyingDescriptions"),
                ElementsAre("CIM:GUID", "CIM:UniqueSystemID", "CIM:Model:SerialNumber", "CIM:Tag", "CIM:Architecture",
                            "CIM:SecureIndicationEnabled"));
}

TEST(CMPIComputerSystem, LeavesUnsetWhatThisHostDoesNotKnow) {
    const om::Instance instance = onlyInstance([](test::Node& node) { node.properties.clear(); });
    EXPECT_THAT(test::namesOf(instance.properties),
                ElementsAre("Description", "OperationalStatus", "HealthState", "CreationClassName",
                            "OtherIdentifyingInfo", "IdentifyingDescriptions", "Dedicated", "Status"));
    test::simulate({test::computer(0, "node7")});
    EXPECT_THAT(test::namesOf(test::instancesOf(test::instances(className)).at(0).properties),
                ElementsAre("Description", "ElementName", "OperationalStatus", "HealthState", "EnabledState",
                            "CreationClassName", "Name", "Dedicated", "UUID", "Status"))
        << "nothing identifies it without a chassis";
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
        const om::Request request = test::askingFor(list, test::asking(om::Operation::GetInstance, named("node7")));
        const std::vector<om::Instance> found = test::instancesOf(test::provider().run(request));
        ASSERT_THAT(found, SizeIs(1));
        EXPECT_EQ(test::namesOf(found[0].properties), all);
    }
}

TEST(CMPIComputerSystem, GetsTheComputersWhoseNameIsExactlyThatOrAllWithoutATextForOne) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    const om::Value text = {CMPI_string, std::string("node8")};
    const std::vector<std::string> all = {"node7", "node8"};
    const std::pair<std::vector<om::NamedValue>, std::vector<std::string>> rows[] = {
        {{{"CreationClassName", {CMPI_string, std::string(className)}}, {"Name", text}}, {"node8"}},
        {{{"CreationClassName", {CMPI_string, std::string("Other")}}, {"Name", text}}, {"node8"}},
        {{{"name", text}}, {"node8"}},
        {{{"NAME", text}}, {"node8"}},
        {{{"Name", {CMPI_string, std::string("NODE8")}}}, {}},
        {{{"Name", {CMPI_string, std::string("node")}}}, {}},
        {{{"Name", {CMPI_string, std::string("node8 ")}}}, {}},
        {{{"Name", {CMPI_string, std::string()}}}, {}},
        {{{"Name", {CMPI_uint64, std::uint64_t{8}}}}, all},
        {{{"CreationClassName", {CMPI_string, std::string(className)}}}, all},
        {{{"Tag", text}}, all},
        {{}, all},
    };
    for (const auto& [keys, names] : rows) {
        om::ObjectPath path = test::path(className);
        path.keys = keys;
        const om::Answer answer = test::get(path);
        EXPECT_EQ(namesIn(answer), names) << testing::PrintToString(test::namesOf(keys));
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        EXPECT_TRUE(answer.done);
    }
}

TEST(CMPIComputerSystem, NarrowsEnumerationsToo) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    EXPECT_THAT(test::provider().run(test::asking(om::Operation::EnumInstanceNames, named("node8"))).results,
                SizeIs(1));
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
