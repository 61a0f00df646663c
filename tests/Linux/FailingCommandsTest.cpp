// Commands that cannot be started because the host is at its limit of processes, and commands that are killed.
#include "Linux/CIMServiceConfig.h"
#include "Linux/CommandStream.h"
#include "Linux/TimeService.h"
#include "support/FakeCommands.h"
#include "support/Isolated.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <unistd.h>

#include <sys/resource.h>

namespace {

using VK::BaseServerProvider::CIMServiceConfig;
using VK::BaseServerProvider::CommandStream;
using VK::BaseServerProvider::TimeService;

constexpr unsigned int failed = 2;

/// Whether this process can start no other one from now on. The limit does not hold for root.
bool reachTheLimitOfProcesses() {
    const rlimit none{0, 0};
    if (setrlimit(RLIMIT_NPROC, &none) != 0) return false;
    constexpr uid_t nobody = 65534;
    return geteuid() != 0 || setuid(nobody) == 0;
}

/// A host whose tree anybody may read and write.
void simulateForAnybody() {
    test::simulate({test::computer(0, "node7")});
    namespace fs = std::filesystem;
    fs::permissions(test::processDirectory(), fs::perms::all);
    fs::permissions(test::processDirectory() / "tree.json", fs::perms::all);
}

TEST(CommandsAtTheLimitOfProcesses, AreFailures) {
    simulateForAnybody();
    test::isolated([] {
        ASSERT_TRUE(reachTheLimitOfProcesses());
        EXPECT_FALSE(CommandStream("echo text", "r"));
        EXPECT_EQ(TimeService().SyncClock(), failed);
        EXPECT_EQ(TimeService().StartService(), failed);
        unsigned int value = 7;
        EXPECT_FALSE(CIMServiceConfig().getIntervalParameter(value));
        EXPECT_EQ(value, 7u);
        EXPECT_EQ(CIMServiceConfig().setIntervalParameter("30"), 1u);
    });
}

TEST(CommandsAtTheLimitOfProcesses, LeaveTheOffsetAndTimeSetAsAFailedSynchronisationDoes) {
    simulateForAnybody();
    test::isolated([] {
        ASSERT_TRUE(reachTheLimitOfProcesses());
        long time = 1704106800;
        unsigned int offset = 120;
        EXPECT_EQ(TimeService().manageTime(time, offset), failed);
    });
    EXPECT_EQ(test::simulatedProperty("/computer/0", 127), 120);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "20240101110000.000000+000");
}

class KilledCommands : public testing::Test {
protected:
    KilledCommands() {
        test::simulate({test::computer(0, "node7")});
        commands.add("ps");
        commands.add("ntpd", test::printing({"ntpd: time slew +0.000012s"}));
    }

    test::FakeCommands commands;
};

TEST_F(KilledCommands, HaveAnsweredWhatTheyPrintedBefore) {
    commands.add("ntpd", test::printing({"ntpd: time slew +0.000012s"}) + "kill -9 $$");
    EXPECT_EQ(TimeService().SyncClock(), 0u);
}

TEST_F(KilledCommands, HaveAnsweredNothingOtherwise) {
    for (const char* signal : {"KILL", "TERM", "SEGV"}) {
        commands.add("ntpd", std::string("kill -") + signal + " $$");
        EXPECT_EQ(TimeService().SyncClock(), failed) << signal;
    }
    commands.add("ntpd", test::printing({"ntpd: time set +1s"}));
    commands.add("ps", "kill -9 $$");
    EXPECT_EQ(TimeService().SyncClock(), 0u) << "no daemon is seen, so that none is stopped";
}

} // namespace
