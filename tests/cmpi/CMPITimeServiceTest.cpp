#include "support/FakeCommands.h"
#include "support/HostName.h"
#include "support/Isolated.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <csignal>
#include <ctime>

namespace {

using test::hostName;
using testing::Contains;
using testing::ContainsRegex;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr char className[] = "VESKA_TimeService";

std::vector<om::NamedValue> setting(const std::string& time) {
    return {
        {"GetRequest", {CMPI_boolean, false}}, {"ManagedElement", {CMPI_ref, {}}}, {"TimeData", {CMPI_dateTime, time}}};
}

om::Answer manage(const std::vector<om::NamedValue>& in) {
    return test::invoke(test::path(className), "ManageTime", in);
}

/// A host on which no NTP daemon runs.
class CMPITimeServiceTest : public testing::Test {
protected:
    CMPITimeServiceTest() {
        test::simulate({test::computer(0, "node7")});
        commands.add("ps");
        commands.add("ntpd", test::printing({"ntpd: time slew +0.000012s"}));
    }

    test::FakeCommands commands;
};

TEST_F(CMPITimeServiceTest, HasOnePathWithItsKeysInOrder) {
    const om::Answer answer = test::names(className);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done) << "the result is left open, which is meant";
    ASSERT_THAT(answer.results, SizeIs(1));
    EXPECT_EQ(test::print(test::paths(answer)[0]), "VESKA_TimeService.Name=\"TimeService@" + hostName() +
                                                       "\",CreationClassName=\"VESKA_TimeService\",SystemName=\"" +
                                                       hostName() +
                                                       "\",SystemCreationClassName=\"VESKA_ComputerSystem\"");
    EXPECT_EQ(test::paths(answer)[0].nameSpace, "root/cimv2");
}

TEST_F(CMPITimeServiceTest, HasOneInstanceWithItsPropertiesInOrder) {
    const om::Answer answer = test::instances(className);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done) << "the result is left open, which is meant";
    ASSERT_THAT(answer.results, SizeIs(1));
    const om::Instance instance = test::instancesOf(answer)[0];
    const auto text = [](const char* name, const std::string& value) {
        return om::NamedValue(name, {CMPI_string, value});
    };
    EXPECT_THAT(instance.properties,
                ElementsAre(text("SystemCreationClassName", "VESKA_ComputerSystem"), text("SystemName", hostName()),
                            text("CreationClassName", "VESKA_TimeService"), text("Name", "TimeService@" + hostName()),
                            om::NamedValue("AutomaticDSTAdjustment", {CMPI_boolean, false})));
}

TEST_F(CMPITimeServiceTest, LeavesOutDaylightSavingWhereItIsUnknown) {
    test::simulate({});
    const om::Answer answer = test::instances(className);
    ASSERT_THAT(answer.results, SizeIs(1)) << "there is a time service without a computer node, too";
    EXPECT_THAT(test::namesOf(test::instancesOf(answer)[0].properties),
                ElementsAre("SystemCreationClassName", "SystemName", "CreationClassName", "Name"));
}

TEST_F(CMPITimeServiceTest, IsGotByAnyKeys) {
    for (const om::ObjectPath& path :
         {test::path(className), test::path(className, {{"Name", "TimeService@other"}, {"SystemName", "other"}})}) {
        const om::Answer answer = test::get(path);
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        EXPECT_TRUE(answer.done);
        EXPECT_THAT(answer.results, SizeIs(1));
    }
}

TEST_F(CMPITimeServiceTest, ModifiesOnlyDaylightSavingWhenTheRegionComesWithIt) {
    const nlohmann::json before = test::simulatedFile();
    EXPECT_EQ(test::modify(test::path(className), {{"Region", {CMPI_uint16, std::uint64_t{4}}}}).code, CMPI_RC_OK);
    EXPECT_EQ(test::modify(test::path(className), {{"Region", {CMPI_string, std::string("Europe")}}}).code, CMPI_RC_OK);
    EXPECT_EQ(test::simulatedFile(), before);
    test::modify(test::path(className),
                 {{"Region", {CMPI_uint16, std::uint64_t{4}}}, {"AutomaticDSTAdjustment", {CMPI_boolean, true}}});
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 1);
}

TEST_F(CMPITimeServiceTest, ReportsSuccessForAModificationThatChangesNothing) {
    const nlohmann::json before = test::simulatedFile();
    for (const std::vector<om::NamedValue>& properties : {std::vector<om::NamedValue>{},
                                                          {{"AutomaticDSTAdjustment", {CMPI_boolean, {}}}},
                                                          {{"AutomaticDSTAdjustment", {CMPI_uint16, std::uint64_t{1}}}},
                                                          {{"Name", {CMPI_string, std::string("x")}}}})
        EXPECT_EQ(test::modify(test::path(className), properties).code, CMPI_RC_OK);
    EXPECT_EQ(test::simulatedFile(), before);
}

TEST_F(CMPITimeServiceTest, GetsTheTimeNowAndChangesNothing) {
    const nlohmann::json before = test::simulatedFile();
    const om::Answer answer =
        manage({{"GetRequest", {CMPI_boolean, true}},
                {"ManagedElement", {CMPI_ref, std::make_shared<const om::ObjectPath>(test::path("CIM_Any"))}}});
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    ASSERT_THAT(test::namesOf(answer.out), ElementsAre("TimeData"));
    char now[16] = {};
    const std::time_t seconds = std::time(nullptr);
    std::strftime(now, sizeof now, "%Y%m%d%H", std::gmtime(&seconds));
    EXPECT_EQ(test::text(answer.out[0].second).substr(0, 10), now);
    EXPECT_EQ(test::simulatedFile(), before);
    EXPECT_THAT(commands.take(), IsEmpty());
}

TEST_F(CMPITimeServiceTest, TracesThatAnIntervalHasNoOffsetAndGoesOn) {
    test::takeLog();
    EXPECT_EQ(manage(setting("00000001000000.000000:000")).code, CMPI_RC_OK);
    EXPECT_THAT(test::takeLog(),
                Contains(ContainsRegex(" LOG 6000 .* CMPITimeService:[0-9]+ invokeMethod: .*offset failed$")));
    EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "ntpd [-xgq]"));
}

TEST_F(CMPITimeServiceTest, RefusesATimeThatNamesNoInstant) {
    const nlohmann::json before = test::simulatedFile();
    const om::Answer answer = manage(setting("20240101120000.******+060"));
    EXPECT_EQ(answer.code, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(answer.out, IsEmpty());
    EXPECT_EQ(test::simulatedFile(), before);
    EXPECT_THAT(commands.take(), IsEmpty());
}

TEST_F(CMPITimeServiceTest, AnswersOneWhenTheHostRefusesOffsetOrTime) {
    for (const unsigned refused : {126U, 127U}) {
        test::Node computer = test::computer(0, "node7");
        computer.failWrites = {refused};
        test::simulate({computer});
        const om::Answer answer = manage(setting("20240101120000.000000+060"));
        EXPECT_EQ(answer.code, CMPI_RC_ERR_FAILED) << refused;
        EXPECT_EQ(std::get<std::uint64_t>(answer.returnValue->data), 1U);
        EXPECT_THAT(answer.out, IsEmpty());
        EXPECT_THAT(commands.take(), IsEmpty());
    }
}

TEST_F(CMPITimeServiceTest, AnswersOneWhenTheSynchronisationFailsAlthoughTheTimeWasSet) {
    commands.add("ntpd", test::printing({"ntpd: no servers found"}));
    const om::Answer answer = manage(setting("20240101120000.000000+060"));
    EXPECT_EQ(answer.code, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(answer.out, IsEmpty());
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "20240101110000.000000+000");
}

TEST_F(CMPITimeServiceTest, SetsTheTimeAlsoWithSigchldIgnored) {
    test::isolated([&] {
        std::signal(SIGCHLD, SIG_IGN);
        EXPECT_EQ(manage(setting("20240101120000.000000+060")).code, CMPI_RC_OK);
        EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "ntpd [-xgq]"));
    });
}

} // namespace
