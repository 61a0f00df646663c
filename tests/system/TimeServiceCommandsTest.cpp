// The commands of the time service through the real shell, with an init script in its real place. What each of them
// answers tests/Linux/TimeServiceTest tries.

#include "Linux/TimeService.h"
#include "support/FakeCommands.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <csignal>
#include <optional>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using VK::BaseServerProvider::TimeService;

constexpr char listProcesses[] = "ps [-ef]";
constexpr char stop[] = "/etc/init.d/ntp [stop]";
constexpr char start[] = "/etc/init.d/ntp [start]";
constexpr char synchronise[] = "ntpd [-xgq]";

/// A host whose daemon is a file: the fake `ps` lists it, the init script makes and removes it.
class TimeServiceCommands : public test::NamespaceTest {
protected:
    void SetUp() override {
        NamespaceTest::SetUp();
        if (IsSkipped()) return;
        initScripts.emplace("/etc/init.d");
        test::simulate({test::computer(0, "node7")});
        commands.add("ps", "echo 'root 1 0 /sbin/init'\n[ ! -e '" + daemon() + "' ] || echo 'ntp 7 1 /usr/sbin/ntpd'");
        commands.add("/etc/init.d/ntp", "case $1 in\nstop) rm '" + daemon() +
                                            "'; echo 'Stopping NTP server: done.';;\n" + "start) : >'" + daemon() +
                                            "'; echo 'Starting NTP server: done.';;\nesac\nexit 1");
        commands.add("ntpd", test::printing({"ntpd: no servers reachable"}) + "exit 1");
    }

    std::string daemon() const { return commands.path("daemon").string(); }
    void setRunning(bool running) {
        std::filesystem::remove(daemon());
        if (running) std::ofstream(daemon()) << "runs";
    }

    std::optional<test::CoveredDirectory> initScripts;
    test::FakeCommands commands;
};

TEST_F(TimeServiceCommands, FailWithoutAnInitScript) {
    std::filesystem::remove("/etc/init.d/ntp");
    setRunning(false);
    EXPECT_EQ(TimeService().StartService(), 2U);
    setRunning(true);
    EXPECT_EQ(TimeService().StopService(), 2U);
}

TEST_F(TimeServiceCommands, FailWithoutASynchronisationProgram) {
    std::filesystem::remove(commands.bin() / "ntpd");
    EXPECT_EQ(TimeService().SyncClock(), 2U);
}

TEST_F(TimeServiceCommands, RunForAClientThatSetsTheTime) {
    setRunning(true);
    const std::vector<om::NamedValue> in = {{"GetRequest", {CMPI_boolean, false}},
                                            {"ManagedElement", {CMPI_ref, {}}},
                                            {"TimeData", {CMPI_dateTime, std::string("20240101120000.000000+060")}}};
    const om::Answer answer = test::invoke(test::path("VESKA_TimeService"), "ManageTime", in);
    EXPECT_EQ(answer.code, CMPI_RC_OK) << "the restart's result replaces that of the synchronisation, which is meant";
    EXPECT_THAT(test::namesOf(answer.out), ElementsAre("TimeData"));
    EXPECT_EQ(test::simulatedProperty("/computer/0", 127), 60);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "20240101110000.000000+000");
    EXPECT_THAT(commands.take(), ElementsAre(listProcesses, listProcesses, stop, synchronise, listProcesses, start));
}

/// A sleeping process under another name, as the system's own `ps` lists it.
class NamedProcess {
public:
    explicit NamedProcess(std::string name) {
        std::string duration = "60";
        char* arguments[] = {name.data(), duration.data(), nullptr};
        if (posix_spawn(&process, "/bin/sleep", nullptr, nullptr, arguments, environ) != 0) process = 0;
    }
    ~NamedProcess() {
        if (process <= 0) return;
        kill(process, SIGKILL);
        waitpid(process, nullptr, 0);
    }
    NamedProcess(const NamedProcess&) = delete;
    NamedProcess& operator=(const NamedProcess&) = delete;

private:
    pid_t process = 0;
};

// With the real ps. No argument of this program or of its test's name may say the daemon's name.
TEST_F(TimeServiceCommands, SeeTheDaemonInTheRealProcessList) {
    if (!std::filesystem::exists("/usr/bin/ps")) GTEST_SKIP() << "this machine has no /usr/bin/ps";
    std::filesystem::remove(commands.bin() / "ps");
    EXPECT_EQ(TimeService().StopService(), 0U) << "nothing of that name runs";
    EXPECT_THAT(commands.take(), IsEmpty());
    for (const char* name : {"ntpd", "/usr/sbin/NTPD", "ntpd: worker"}) {
        const NamedProcess process(name);
        EXPECT_EQ(TimeService().StartService(), 0U) << name << " runs already";
        EXPECT_THAT(commands.take(), IsEmpty());
        TimeService().StopService();
        EXPECT_THAT(commands.take(), ElementsAre(stop)) << name;
    }
    const NamedProcess other("chronyd");
    TimeService().StartService();
    EXPECT_THAT(commands.take(), ElementsAre(start)) << "another daemon does not count";
}

} // namespace
