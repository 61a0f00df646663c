#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr char className[] = "VESKA_EnabledLogicalElementCapabilities";

TEST(CMPIEnabledLogicalElementCapabilities, AreNamedByTheirInstanceIDAlone) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::computer(1, "b")});
    const om::Answer answer = test::names(className);
    EXPECT_THAT(test::printed(answer),
                ElementsAre("VESKA_EnabledLogicalElementCapabilities.InstanceID=\"/computer/0\"",
                            "VESKA_EnabledLogicalElementCapabilities.InstanceID=\"/computer/1\""));
    EXPECT_TRUE(answer.done);
}

TEST(CMPIEnabledLogicalElementCapabilities, HoldThreePropertiesAndNothingElse) {
    test::simulate({test::computer(0, "node7")});
    const om::Answer answer = test::get(test::paths(test::names(className))[0]);
    ASSERT_EQ(answer.results.size(), 1U);
    const om::Instance instance = test::instancesOf(answer)[0];
    EXPECT_THAT(instance.properties,
                ElementsAre(om::NamedValue("InstanceID", {CMPI_string, std::string("/computer/0")}),
                            om::NamedValue("ElementName", {CMPI_string, std::string("node7")}),
                            om::NamedValue("ElementNameEditSupported", {CMPI_boolean, false})));
    EXPECT_TRUE(answer.done);
}

TEST(CMPIEnabledLogicalElementCapabilities, LeaveOutWhatTheHostCannotAnswer) {
    test::Node node = test::computer(0, "");
    node.properties.erase(108);
    node.unanswerable = {108};
    test::simulate({node});
    const om::Answer answer = test::instances(className);
    EXPECT_THAT(test::namesOf(test::instancesOf(answer)[0].properties), ElementsAre("InstanceID"));
    EXPECT_FALSE(answer.done); // on purpose: this enumeration is not closed
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

} // namespace
