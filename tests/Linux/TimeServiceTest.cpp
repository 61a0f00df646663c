#include "Linux/TimeService.h"
#include "support/FakeCommands.h"
#include "support/HostName.h"
#include "support/ShellCalls.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <fstream>

namespace {

using test::hostName;
using testing::Contains;
using testing::ContainsRegex;
using testing::ElementsAre;

using testing::IsEmpty;
using VK::BaseServerProvider::TimeService;

const std::string ps = "popen r: ps -ef|grep -i \"ntpd\"|grep -v grep";
const std::string synchronise = "popen r: ntpd -xgq";

/// A simulated host with one computer, on which no NTP daemon runs. The machine's own init script is never started.
class TimeServiceTest : public testing::Test {
protected:
    TimeServiceTest() {
        test::simulate({test::computer(0, hostName())});
        test::refuseToStart("/etc/init.d/");
        commands.add("ps", test::printing({"root 1 0 /sbin/init"}));
        commands.add("ntpd", test::printing({"ntpd: time set +0.000012s"}));
        test::takeShellCalls();
        test::takeLog();
    }
    ~TimeServiceTest() override {
        test::refuseToStart("");
        test::startInstead("", "");
    }

    void runDaemon(const std::string& line = "ntp 812 1 /usr/sbin/ntpd -g") {
        commands.add("ps", test::printing({"root 1 0 /sbin/init", line}));
    }

    /// Gives the host an init script.
    void addInitScript(const std::string& script) {
        test::refuseToStart("");
        test::startInstead("/etc/init.d/", commands.path("init.d/").string());
        commands.add(commands.path("init.d/ntp"), script);
    }

    test::FakeCommands commands;
};

TEST_F(TimeServiceTest, IsNamedAfterTheHost) {
    const TimeService service;
    const std::pair<bool (TimeService::*)(std::string&) const, std::string> texts[] = {
        {&TimeService::getName, "TimeService@" + hostName()},
        {&TimeService::getSystemName, hostName()},
        {&TimeService::getCreationClassName, "VESKA_TimeService"},
        {&TimeService::getSystemCreationClassName, "VESKA_ComputerSystem"},
    };
    for (const auto& [getter, expected] : texts) {
        std::string text;
        EXPECT_TRUE((service.*getter)(text));
        EXPECT_EQ(text, expected);
    }
}

TEST_F(TimeServiceTest, HasNoRegionAndLeavesTheArgumentUnchangedWithoutALine) {
    TimeService service;
    test::takeLog();
    std::string region = "before";
    EXPECT_FALSE(service.getRegion(region));
    EXPECT_EQ(region, "before");
    EXPECT_FALSE(service.setRegion("Europe"));
    EXPECT_THAT(test::takeLog(), IsEmpty());
}

TEST_F(TimeServiceTest, TellsDaylightSavingByTheHostsNumber) {
    for (const unsigned number : {0U, 1U, 2U, 4294967295U}) {
        test::Node computer = test::computer(0, "node7");
        computer.properties[200] = number;
        test::simulate({computer});
        bool automatic = number == 0;
        EXPECT_TRUE(TimeService().getAutomaticDSTAdjustment(automatic));
        EXPECT_EQ(automatic, number != 0) << number;
    }
}

TEST_F(TimeServiceTest, StoresFalseWhenDaylightSavingIsUnknown) {
    test::Node without = test::computer(0, "node7");
    without.properties.erase(200);
    test::Node asText = test::computer(0, "node7");
    asText.properties[200] = "1";
    for (const std::vector<test::Node>& nodes : {std::vector{without}, std::vector{asText}, {}}) {
        test::simulate(nodes);
        bool automatic = true;
        EXPECT_FALSE(TimeService().getAutomaticDSTAdjustment(automatic));
        EXPECT_FALSE(automatic);
    }
}

TEST_F(TimeServiceTest, WritesDaylightSavingAsOneOrZero) {
    EXPECT_TRUE(TimeService().setAutomaticDSTAdjustment(true));
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 1);
    EXPECT_TRUE(TimeService().setAutomaticDSTAdjustment(false));
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 0);
}

TEST_F(TimeServiceTest, AnswersFalseWhenDaylightSavingCannotBeWritten) {
    test::Node computer = test::computer(0, "node7");
    computer.failWrites = {200};
    test::simulate({computer});
    EXPECT_FALSE(TimeService().setAutomaticDSTAdjustment(true));
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 0);
    test::simulate({});
    EXPECT_FALSE(TimeService().setAutomaticDSTAdjustment(true));
}

TEST_F(TimeServiceTest, TakesTheFirstLineOfACommandsOutput) {
    TimeService service;
    std::string output = "before";
    EXPECT_TRUE(service.executeCommand("printf 'one\\ntwo\\n'", "r", output));
    EXPECT_EQ(output, "one\n");
    EXPECT_TRUE(service.executeCommand("true", "r", output));
    EXPECT_EQ(output, "");
    EXPECT_TRUE(service.executeCommand("echo text; exit 7", "r", output));
    EXPECT_EQ(output, "text\n");
    EXPECT_TRUE(service.executeCommand("echo text >&2", "r", output));
    EXPECT_EQ(output, "");
    EXPECT_TRUE(service.executeCommand("printf 'one\\0two\\n'", "r", output));
    EXPECT_EQ(output, "one");
}

TEST_F(TimeServiceTest, TakesNoMoreThan511BytesOfALine) {
    std::string output;
    EXPECT_TRUE(TimeService().executeCommand("printf '%01000d\\n' 1", "r", output));
    EXPECT_EQ(output, std::string(511, '0'));
}

TEST_F(TimeServiceTest, LeavesTheOutputAloneWhenACommandCannotBeStarted) {
    test::refuseToStart("echo");
    std::string output = "before";
    EXPECT_FALSE(TimeService().executeCommand("echo text", "r", output));
    EXPECT_EQ(output, "before");
}

TEST_F(TimeServiceTest, HandsTheModeOn) {
    std::string output;
    TimeService().executeCommand("true", "re", output);
    EXPECT_THAT(test::takeShellCalls(), ElementsAre("popen re: true"));
}

TEST_F(TimeServiceTest, StopsNothingWhereNoDaemonRuns) {
    test::takeLog();
    EXPECT_EQ(TimeService().StopService(), 0U);
    EXPECT_THAT(test::takeLog(), Contains(ContainsRegex(" LOG 4000 .* StopService: ENTERING: ")));
    EXPECT_THAT(test::takeShellCalls(), ElementsAre(ps));
    EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]"));
}

TEST_F(TimeServiceTest, StartsNothingWhereADaemonRuns) {
    runDaemon();
    test::takeLog();
    EXPECT_EQ(TimeService().StartService(), 0U);
    EXPECT_THAT(test::takeLog(), Contains(ContainsRegex(" LOG 4000 .* StartService: ENTERING: ")));
    EXPECT_THAT(test::takeShellCalls(), ElementsAre(ps));
}

TEST_F(TimeServiceTest, FailsWhenTheInitScriptCannotBeStarted) {
    EXPECT_EQ(TimeService().StartService(), 2U);
    EXPECT_THAT(test::takeShellCalls(), ElementsAre(ps, "popen r: /etc/init.d/ntp start"));
    runDaemon();
    EXPECT_EQ(TimeService().StopService(), 2U);
    EXPECT_THAT(test::takeShellCalls(), ElementsAre(ps, "popen r: /etc/init.d/ntp stop"));
}

TEST_F(TimeServiceTest, KnowsADaemonByItsNameInAnyCase) {
    runDaemon("ntp 812 1 /opt/NTPD");
    EXPECT_EQ(TimeService().StartService(), 0U);
    runDaemon("root 900 899 grep -i ntpd");
    EXPECT_EQ(TimeService().StopService(), 0U);
}

TEST_F(TimeServiceTest, CountsAProcessListThatCannotBeStartedAsNotRunning) {
    runDaemon();
    test::refuseToStart("ps -ef");
    EXPECT_EQ(TimeService().StopService(), 0U);
    EXPECT_THAT(test::takeShellCalls(), ElementsAre(ps));
}

TEST_F(TimeServiceTest, SynchronisesByTheFirstLineWhereNoDaemonRuns) {
    const struct {
        std::vector<std::string> printed;
        unsigned int result;
    } table[] = {
        {{"ntpd: time slew +0.001200s"}, 0},
        {{"ntpd: time set -3.500000s"}, 0},
        {{"2026-11-21T06:00:00 ntpd[7]: ntpd: time slew +0.0s", "more"}, 0},
        {{"ntpd: time sle"}, 2},
        {{"ntpd: time  set"}, 2},
        {{"NTPD: TIME SET"}, 2},
        {{"ntpd: no servers found"}, 2},
        {{""}, 2},
        {{}, 2},
        {{"2026-11-21T06:00:00 ntpd[7]: INIT", "ntpd: time slew +0.001200s"}, 2},
    };
    for (const auto& row : table) {
        commands.add("ntpd", test::printing(row.printed) + "exit 1");
        EXPECT_EQ(TimeService().SyncClock(), row.result) << testing::PrintToString(row.printed);
        EXPECT_THAT(test::takeShellCalls(), ElementsAre(ps, synchronise));
        EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "ntpd [-xgq]"));
    }
}

TEST_F(TimeServiceTest, BelievesTheFirstLineOfTheInitScriptAlone) {
    const struct {
        std::vector<std::string> printed;
        unsigned int result;
    } table[] = {
        {{"Stopping NTP server: ntpd."}, 2},
        {{"Stopping NTP server: done"}, 0},
        {{"done."}, 0},
        {{"undone"}, 0}, // the word may stand anywhere
        {{"don"}, 2},
        {{"Done"}, 2},
        {{"Stopping NTP server", "done"}, 2},
        {{}, 2},
    };
    for (const auto& row : table) {
        addInitScript(test::printing(row.printed) + "exit 1");
        commands.add("ps");
        EXPECT_EQ(TimeService().StartService(), row.result) << testing::PrintToString(row.printed);
        runDaemon();
        EXPECT_EQ(TimeService().StopService(), row.result) << testing::PrintToString(row.printed);
        EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "init.d/ntp [start]", "ps [-ef]", "init.d/ntp [stop]"));
    }
}

TEST_F(TimeServiceTest, AnswersARunningDaemonsRestartWhateverTheSynchronisationDid) {
    const std::string running = commands.path("running").string();
    commands.add("ps", "test ! -e " + running + " || echo ntp 812 1 /usr/sbin/ntpd");
    const struct {
        const char* synchronisation;
        const char* start;
        unsigned int result;
    } table[] = {
        {"ntpd: no servers found", "done", 0},
        {"ntpd: time slew +0.0s", "failed", 2},
        {"ntpd: time slew +0.0s", "done", 0},
    };
    for (const auto& row : table) {
        addInitScript("rm -f " + running + "; test $1 = start && echo " + row.start + " || echo done");
        commands.add("ntpd", test::printing({row.synchronisation}));
        std::ofstream(running).close();
        EXPECT_EQ(TimeService().SyncClock(), row.result) << row.synchronisation << ", start: " << row.start;
        EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "ps [-ef]", "init.d/ntp [stop]", "ntpd [-xgq]", "ps [-ef]",
                                                 "init.d/ntp [start]"));
    }
}

TEST_F(TimeServiceTest, SynchronisesWithADaemonThatWouldNotStopAndStartsNoOther) {
    addInitScript("echo failed");
    runDaemon();
    commands.add("ntpd", test::printing({"ntpd: no servers found"}));
    EXPECT_EQ(TimeService().SyncClock(), 0U);
    EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "ps [-ef]", "init.d/ntp [stop]", "ntpd [-xgq]", "ps [-ef]"));
}

TEST_F(TimeServiceTest, FailsWhenTheSynchronisationCannotBeStarted) {
    test::refuseToStart("ntpd -xgq");
    EXPECT_EQ(TimeService().SyncClock(), 2U);
}

TEST_F(TimeServiceTest, SetsOffsetAndTimeAndSynchronises) {
    long time = 1704106800;
    unsigned int offset = 60;
    EXPECT_EQ(TimeService().manageTime(time, offset), 0U);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 127), 60);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "20240101110000.000000+000");
    EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "ntpd [-xgq]"));
}

TEST_F(TimeServiceTest, AnswersTheSynchronisationsFailureWithOffsetAndTimeSet) {
    commands.add("ntpd", test::printing({"ntpd: no servers found"}));
    long time = 1704106800;
    unsigned int offset = static_cast<unsigned int>(-300);
    EXPECT_EQ(TimeService().manageTime(time, offset), 2U);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 127), 4294966996U);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "20240101110000.000000+000");
}

TEST_F(TimeServiceTest, RunsNothingWhenOffsetOrTimeCannotBeWritten) {
    const struct {
        unsigned refused;
        int offset; ///< which is written first
        const char* message;
    } table[] = {{127, 60, "timezone"}, {126, 120, "Time"}};
    for (const auto& row : table) {
        test::Node computer = test::computer(0, hostName());
        computer.failWrites = {row.refused};
        test::simulate({computer});
        test::takeLog();
        long time = 1704106800;
        unsigned int offset = 120;
        EXPECT_EQ(TimeService().manageTime(time, offset), 2U);
        EXPECT_EQ(test::simulatedProperty("/computer/0", 127), row.offset);
        EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "");
        EXPECT_THAT(test::takeShellCalls(), IsEmpty());
        EXPECT_THAT(test::takeLog(),
                    Contains(ContainsRegex(" LOG 3000 .* TimeService:[0-9]+ manageTime: .*setProperty::" +
                                           std::string(row.message) + " failed!!$")));
    }
}

} // namespace
