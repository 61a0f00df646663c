#include "instrumentation/ZoneChange.h"

#include "LogCapture.h"
#include "instrumentation/HostState.h"
#include "support/HostCopy.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstdlib>
#include <functional>
#include <optional>
#include <sys/ptrace.h>
#include <sys/wait.h>
#include <unistd.h>

namespace VK::Inside {

namespace {

using support::HostCopy;

/// Lets a process that is being traced go on to its next stop at the begin or end of a system call; false when it came
/// to its end instead.
bool goOn(pid_t child) {
    int status = 0;
    ptrace(PTRACE_SYSCALL, child, nullptr, nullptr);
    waitpid(child, &status, 0);
    return !WIFEXITED(status);
}

enum Outcome { Killed, Finished, NotTraced };

/// Runs something in a process that is killed as it begins its n-th system call.
Outcome runKilledAt(const std::function<void()>& run, int n) {
    const pid_t child = fork();
    if (child == 0) {
        if (ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0) _exit(99);
        raise(SIGSTOP);
        run();
        _exit(0);
    }
    int status = 0;
    waitpid(child, &status, 0);
    if (WIFEXITED(status)) return NotTraced;
    for (int call = 0; call < n; ++call)
        if (!goOn(child) || !goOn(child)) return Finished;
    if (!goOn(child)) return Finished;
    kill(child, SIGKILL);
    waitpid(child, &status, 0);
    return Killed;
}

/// A copy in memory, where there is a place for it: hundreds of synchronised files take long on a disk.
class FastCopy {
public:
    FastCopy() : before(value()) {
        if (access("/dev/shm", W_OK) == 0) setenv("TMPDIR", "/dev/shm", 1);
        host.emplace();
        if (before.empty())
            unsetenv("TMPDIR");
        else
            setenv("TMPDIR", before.c_str(), 1);
    }
    const HostCopy& operator*() const { return *host; }

private:
    static std::string value() {
        const char* found = getenv("TMPDIR");
        return found != nullptr ? found : "";
    }
    std::string before;
    std::optional<HostCopy> host;
};

/// Kills a change at each of its system calls; the zone must be the old or the new one each time, and the host must be
/// able to go on.
void killEverywhere(const char* zone, const std::function<void(const Root&)>& prepare,
                    const std::function<bool(const Root&)>& change, int oldOffset, int newOffset) {
    constexpr std::int64_t WINTER_2026 = 1768435200;
    const FastCopy copy;
    const HostCopy& host = *copy;
    const Root root(host.path());
    int calls = 0;
    for (Outcome outcome = Killed; outcome == Killed; ++calls) {
        host.remove("var");
        host.remove("etc");
        host.useZone(zone);
        prepare(root);
        outcome = runKilledAt([&] { change(root); }, calls);
        if (outcome == NotTraced) GTEST_SKIP() << "processes may not be traced here";
        const auto found = zoneOfFile(root, "/etc/localtime");
        ASSERT_TRUE(found.has_value()) << "no zone after " << calls << " calls";
        const int winter = found->at(WINTER_2026).offset / 60;
        ASSERT_TRUE(winter == oldOffset || winter == newOffset) << winter << " after " << calls << " calls";
        ASSERT_TRUE(change(root)) << "after " << calls << " calls";
        ASSERT_EQ(zoneInForce(root).at(WINTER_2026).offset / 60, newOffset);
    }
    EXPECT_GT(calls, 40); // there were some to kill at
    support::takeLog();
}

TEST(ZoneChangeCrash, WhileTheOffsetIsChanged) {
    killEverywhere(
        "Europe/Berlin", [](const Root&) {}, [](const Root& root) { return changeOffset(root, 330); }, 60, 330);
}

TEST(ZoneChangeCrash, WhileDaylightSavingIsSwitchedOff) {
    killEverywhere(
        "Australia/Adelaide", [](const Root&) {}, [](const Root& root) { return changeDaylightSaving(root, false); },
        630, 570);
}

TEST(ZoneChangeCrash, WhileDaylightSavingIsSwitchedOn) {
    killEverywhere(
        "Australia/Adelaide", [](const Root& root) { changeDaylightSaving(root, false); },
        [](const Root& root) { return changeDaylightSaving(root, true); }, 570, 630);
}

} // namespace

} // namespace VK::Inside
