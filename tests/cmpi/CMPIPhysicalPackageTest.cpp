#include "cmpi/CMPIPhysicalPackage.h"
#include "support/Provider.h"
#include "support/Requests.h"
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

TEST(CMPIPhysicalPackage, NamesAChassisByClassAndBySerialNumberWhereItHasOne) {
    test::simulate({test::chassis(0, 0, "CZ1234"), test::without(test::chassis(0, 1, ""), 50)});
    const om::Answer answer = test::names("VESKA_PhysicalPackage");
    EXPECT_THAT(test::printed(answer),
                ElementsAre("VESKA_PhysicalPackage.CreationClassName=\"VESKA_PhysicalPackage\",Tag=\"CZ1234\"",
                            "VESKA_PhysicalPackage.CreationClassName=\"VESKA_PhysicalPackage\""));
    EXPECT_EQ(test::paths(answer)[0].nameSpace, "root/cimv2");
    EXPECT_TRUE(answer.done);
    EXPECT_THAT(tags(test::instances("VESKA_PhysicalPackage")), ElementsAre("CZ1234", "(not set)"));
}

TEST(CMPIPhysicalPackage, SetsWhatTheHostSuppliesInOrderAndNothingElse) {
    test::simulate({test::chassis(0, 0, "CZ1234")});
    const om::Instance instance = only(test::instances("VESKA_PhysicalPackage"));
    const auto text = [](const char* name, const char* value) {
        return om::NamedValue(name, {CMPI_string, std::string(value)});
    };
    EXPECT_THAT(instance.properties,
                ElementsAre(text("Tag", "CZ1234"), text("Description", "Rack Mount Chassis"),
                            text("CreationClassName", "VESKA_PhysicalPackage"),
                            text("ElementName", "Rack Mount Chassis"), text("Manufacturer", "Example"),
                            text("Model", "Box"), text("SKU", "SKU-1"), text("SerialNumber", "CZ1234"),
                            om::NamedValue("PackageType", {CMPI_uint16, std::uint64_t{2}})));
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
    const om::Request request = test::asking(om::Operation::EnumInstances, test::path("VESKA_PhysicalPackage"));
    for (const std::vector<std::string>& list : {std::vector<std::string>{"Tag"}, {}})
        EXPECT_EQ(only(test::provider().run(test::askingFor(list, request))).properties.size(), 9U);
}

TEST(CMPIPhysicalPackage, AnswersAnUnknownTagWithNothingAndNoError) {
    test::simulate({test::chassis(0, 0, "A")});
    const om::Answer answer = test::get(test::path("VESKA_PhysicalPackage", {{"Tag", "B"}}));
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

TEST(CMPIPhysicalPackage, AsksAPathWithoutKeysForNone) {
    static int asked;
    asked = 0;
    CMPIObjectPathFT table = {};
    table.getKeyCount = [](const CMPIObjectPath*, CMPIStatus*) -> CMPICount { return 0; };
    table.getKey = [](const CMPIObjectPath*, const char*, CMPIStatus*) {
        ++asked;
        return CMPIData{};
    };
    const CMPIObjectPath path = {&table, &table};
    test::simulate({test::chassis(0, 0, "A")});
    VK::BaseServerProvider::CMPIPhysicalPackage adapter(test::provider().broker(), nullptr, std::string("root/cimv2"));
    adapter.setObjectPath(&path);
    EXPECT_EQ(asked, 0);
    EXPECT_TRUE(adapter);
}

} // namespace
