#include "cmpi/CMPIEnabledLogicalElementCapabilities.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr char className[] = "VESKA_EnabledLogicalElementCapabilities";

TEST(CMPIEnabledLogicalElementCapabilities, AreNamedByTheirInstanceIDAlone) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::computer(1, "b")});
    const om::Answer answer = test::names(className);
    std::vector<std::string> printed;
    for (const om::ObjectPath& path : test::paths(answer)) printed.push_back(test::print(path));
    EXPECT_THAT(printed, ElementsAre("VESKA_EnabledLogicalElementCapabilities.InstanceID=\"/computer/0\"",
                                     "VESKA_EnabledLogicalElementCapabilities.InstanceID=\"/computer/1\""));
    EXPECT_TRUE(answer.done);
}

TEST(CMPIEnabledLogicalElementCapabilities, HoldThreePropertiesAndNothingElse) {
    test::simulate({test::computer(0, "node7")});
    const om::Answer answer = test::get(test::paths(test::names(className))[0]);
    ASSERT_EQ(answer.results.size(), 1U);
    const om::Instance instance = test::instancesOf(answer)[0];
    ASSERT_THAT(test::namesOf(instance.properties),
                ElementsAre("InstanceID", "ElementName", "ElementNameEditSupported"));
    EXPECT_EQ(test::text(instance.properties[0].second), "/computer/0");
    EXPECT_EQ(test::text(instance.properties[1].second), "node7");
    EXPECT_EQ(instance.properties[2].second.type, CMPI_boolean);
    EXPECT_FALSE(std::get<bool>(instance.properties[2].second.data));
    EXPECT_TRUE(answer.done);
}

TEST(CMPIEnabledLogicalElementCapabilities, LeaveOutWhatTheHostCannotAnswer) {
    test::Node node = test::computer(0, "");
    node.properties.erase(108);
    node.unanswerable = {108};
    test::simulate({node});
    const om::Answer answer = test::instances(className);
    EXPECT_THAT(test::namesOf(test::instancesOf(answer)[0].properties), ElementsAre("InstanceID"));
    EXPECT_FALSE(answer.done); // meant: this enumeration is not closed
}

TEST(CMPIEnabledLogicalElementCapabilities, AnswerAnUnknownInstanceIDWithNothingAndNoError) {
    test::simulate({test::computer(0, "node7")});
    const om::Answer answer = test::get(test::path(className, {{"InstanceID", "/computer/7"}}));
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

TEST(CMPIEnabledLogicalElementCapabilities, AreAllAnsweredForAPathWithoutInstanceID) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    EXPECT_EQ(test::get(test::path(className)).results.size(), 2U);
    EXPECT_EQ(test::get(test::path(className, {{"Name", "a"}})).results.size(), 2U);
}

TEST(CMPIEnabledLogicalElementCapabilities, StartAgainFromTheFirstComputerWithAMethodLine) {
    test::simulate({test::computer(0, "a")});
    VK::BaseServerProvider::CMPIEnabledLogicalElementCapabilities adapter(test::provider().broker(), nullptr,
                                                                          "root/cimv2");
    ++adapter;
    EXPECT_FALSE(adapter);
    test::takeLog();
    adapter.initialize();
    EXPECT_EQ(test::withoutPlaces(test::takeLog()).at(0),
              "LOG 4000 Norvane.BaseServerProvider CMPIEnabledLogicalElementCapabilities initialize: METHOD: "
              "initialize() was invoked in CMPIEnabledLogicalElementCapabilities [Line]");
    EXPECT_TRUE(adapter);
}

TEST(CMPIEnabledLogicalElementCapabilities, TraceTheInstanceIDThatTheyAreAskedFor) {
    test::simulate({test::computer(0, "a")});
    test::takeLog();
    test::get(test::path(className, {{"InstanceID", "/computer/0"}}));
    EXPECT_THAT(test::withoutPlaces(test::takeLog()),
                testing::Contains("LOG 4000 Norvane.BaseServerProvider CMPIEnabledLogicalElementCapabilities "
                                  "setObjectPath: VARIABLE: 'instanceId' has Value '/computer/0' [Line] in "
                                  "CMPIEnabledLogicalElementCapabilities"));
}

} // namespace
