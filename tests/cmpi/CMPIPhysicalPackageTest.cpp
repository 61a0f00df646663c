#include "cmpi/CMPIPhysicalPackage.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

om::Instance only(const om::Answer& answer) {
    EXPECT_EQ(answer.results.size(), 1U);
    return answer.results.empty() ? om::Instance{} : test::instancesOf(answer)[0];
}

std::string property(const om::Instance& instance, const std::string& name) {
    const om::Value* value = test::find(instance.properties, name);
    return value == nullptr ? "(not set)" : test::text(*value);
}

std::vector<std::string> tags(const om::Answer& answer) {
    std::vector<std::string> found;
    for (const om::Instance& instance : test::instancesOf(answer)) found.push_back(property(instance, "Tag"));
    return found;
}

TEST(CMPIPhysicalPackage, NamesAChassisByClassAndSerialNumber) {
    test::simulate({test::chassis(0, 0, "CZ1234")});
    const om::Answer answer = test::names("VESKA_PhysicalPackage");
    ASSERT_EQ(answer.results.size(), 1U);
    EXPECT_EQ(test::print(test::paths(answer)[0]),
              "VESKA_PhysicalPackage.CreationClassName=\"VESKA_PhysicalPackage\",Tag=\"CZ1234\"");
    EXPECT_EQ(test::paths(answer)[0].nameSpace, "root/cimv2");
    EXPECT_TRUE(answer.done);
}

TEST(CMPIPhysicalPackage, NamesAChassisWithoutSerialNumberByItsClassAlone) {
    test::Node chassis = test::chassis(0, 0, "");
    chassis.properties.erase(50);
    test::simulate({chassis});
    EXPECT_EQ(test::print(test::paths(test::names("VESKA_PhysicalPackage"))[0]),
              "VESKA_PhysicalPackage.CreationClassName=\"VESKA_PhysicalPackage\"");
    EXPECT_EQ(property(only(test::instances("VESKA_PhysicalPackage")), "Tag"), "(not set)");
}

TEST(CMPIPhysicalPackage, SetsWhatTheHostSuppliesInOrderAndNothingElse) {
    test::simulate({test::chassis(0, 0, "CZ1234")});
    const om::Instance instance = only(test::instances("VESKA_PhysicalPackage"));
    EXPECT_THAT(test::namesOf(instance.properties),
                ElementsAre("Tag", "Description", "CreationClassName", "ElementName", "Manufacturer", "Model", "SKU",
                            "SerialNumber", "PackageType"));
    EXPECT_EQ(property(instance, "Tag"), "CZ1234");
    EXPECT_EQ(property(instance, "Description"), "Rack Mount Chassis");
    EXPECT_EQ(property(instance, "CreationClassName"), "VESKA_PhysicalPackage");
    EXPECT_EQ(property(instance, "ElementName"), "Rack Mount Chassis");
    EXPECT_EQ(property(instance, "Manufacturer"), "Example");
    EXPECT_EQ(property(instance, "Model"), "Box");
    EXPECT_EQ(property(instance, "SKU"), "SKU-1");
    EXPECT_EQ(property(instance, "SerialNumber"), "CZ1234");
    const om::Value& type = *test::find(instance.properties, "PackageType");
    EXPECT_EQ(type.type, CMPI_uint16);
    EXPECT_EQ(std::get<std::uint64_t>(type.data), 2U);
}

TEST(CMPIPhysicalPackage, SetsAnEmptyDescriptionButNoElementName) {
    test::Node chassis = test::chassis(0, 0, "A");
    chassis.description.clear();
    test::simulate({chassis});
    const om::Instance instance = only(test::instances("VESKA_PhysicalPackage"));
    EXPECT_EQ(property(instance, "Description"), "");
    EXPECT_EQ(property(instance, "ElementName"), "(not set)");
}

TEST(CMPIPhysicalPackage, IsNarrowedByTagAndBySystemName) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b"), test::chassis(0, 0, "A"), test::chassis(1, 0, "A"),
                    test::chassis(1, 1, "B")});
    const auto get = [](const std::vector<std::pair<std::string, std::string>>& keys) {
        return tags(test::get(test::path("VESKA_PhysicalPackage", keys)));
    };
    EXPECT_THAT(get({{"Tag", "A"}}), ElementsAre("A", "A"));
    EXPECT_THAT(get({{"SystemName", "/computer/1"}}), ElementsAre("A", "B"));
    EXPECT_THAT(get({{"Tag", "A"}, {"SystemName", "/computer/1"}}), ElementsAre("A"));
    EXPECT_THAT(get({{"tag", "B"}}), ElementsAre("B"));
    EXPECT_THAT(get({{"Tag", "b"}}), IsEmpty());
    EXPECT_THAT(get({}), ElementsAre("A", "A", "B"));
    EXPECT_THAT(get({{"CreationClassName", "VESKA_Other"}}), ElementsAre("A", "A", "B"));
}

TEST(CMPIPhysicalPackage, DoesNotApplyThePropertyList) {
    test::simulate({test::chassis(0, 0, "A")});
    om::Request request;
    request.operation = om::Operation::EnumInstances;
    request.path = test::path("VESKA_PhysicalPackage");
    request.propertyList = {"Tag"};
    EXPECT_EQ(only(test::provider().run(request)).properties.size(), 9U);
    request.propertyList = std::vector<std::string>{};
    EXPECT_EQ(only(test::provider().run(request)).properties.size(), 9U);
}

TEST(CMPIPhysicalPackage, AnswersAnUnknownTagWithNothingAndNoError) {
    test::simulate({test::chassis(0, 0, "A")});
    const om::Answer answer = test::get(test::path("VESKA_PhysicalPackage", {{"Tag", "B"}}));
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

/// What the adapter's functions wrote into the log channel, from the function's name on.
std::vector<std::string> linesOf(const std::string& function) {
    const std::string head = "LOG 4000 Norvane.BaseServerProvider CMPIPhysicalPackage ";
    std::vector<std::string> lines;
    for (const std::string& line : test::withoutPlaces(test::takeLog()))
        if (line.rfind(head + function, 0) == 0) lines.push_back(line.substr(head.size()));
    return lines;
}

TEST(CMPIPhysicalPackage, FiltersByTagFirstAndTracesBoth) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")});
    test::takeLog();
    test::get(test::path("VESKA_PhysicalPackage", {{"SystemName", "/computer/0"}, {"Tag", "A"}}));
    EXPECT_THAT(
        linesOf("setObjectPath: VARIABLE"),
        ElementsAre("setObjectPath: VARIABLE: 'tag' has Value 'A' [Line] in CMPIPhysicalPackage",
                    "setObjectPath: VARIABLE: 'systemName' has Value '/computer/0' [Line] in CMPIPhysicalPackage"));
}

TEST(CMPIPhysicalPackage, StartsAgainFromTheFirstChassisWithAMethodLine) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")});
    VK::BaseServerProvider::CMPIPhysicalPackage adapter(test::provider().broker(), nullptr, "root/cimv2");
    ++adapter;
    EXPECT_FALSE(adapter);
    test::takeLog();
    adapter.initialize();
    EXPECT_THAT(linesOf("initialize"),
                ElementsAre("initialize: METHOD: initialize() was invoked in CMPIPhysicalPackage [Line]"));
    EXPECT_TRUE(adapter);
}

} // namespace
