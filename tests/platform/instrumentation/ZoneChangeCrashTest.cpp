#include "instrumentation/ZoneChange.h"

#include "LogCapture.h"
#include "instrumentation/HostState.h"
#include "support/HostCopy.h"

#include <gtest/gtest.h>

#include <csignal>
#include <functional>
#include <sys/ptrace.h>
#include <sys/wait.h>
#include <unistd.h>

namespace VK::Inside {

namespace {

using support::HostCopy;

/// Runs something in a process that is killed when it makes its n-th stop at the begin or end of a system call. True
/// when it was killed, false when it came to its end before.
bool killedAtStop(const std::function<void()>& run, int n, std::string& problem) {
    const pid_t child = fork();
    if (child == 0) {
        if (ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0) _exit(99);
        raise(SIGSTOP);
        run();
        _exit(0);
    }
    int status = 0;
    waitpid(child, &status, 0);
    if (WIFEXITED(status)) {
        problem = "ptrace is not allowed here";
        return false;
    }
    for (int stop = 0; stop < n; ++stop) {
        ptrace(PTRACE_SYSCALL, child, nullptr, nullptr);
        waitpid(child, &status, 0);
        if (WIFEXITED(status)) return false;
    }
    kill(child, SIGKILL);
    waitpid(child, &status, 0);
    return true;
}

/// Kills a change at each of its system calls; the zone must be the old or the new one each time, and the host must be
/// able to go on.
void killEverywhere(const char* zone, const std::function<void(const Root&)>& prepare,
                    const std::function<bool(const Root&)>& change, int oldOffset, int newOffset) {
    int stops = 0;
    for (bool killed = true; killed; ++stops) {
        HostCopy host;
        host.useZone(zone);
        const Root root(host.path());
        prepare(root);
        std::string problem;
        killed = killedAtStop([&] { change(root); }, stops, problem);
        if (!problem.empty()) GTEST_SKIP() << problem;
        const auto found = zoneOfFile(root, "/etc/localtime");
        ASSERT_TRUE(found.has_value()) << "no zone after stop " << stops;
        const int winter = found->at(1768435200).offset / 60; // 2026-01-15
        ASSERT_TRUE(winter == oldOffset || winter == newOffset) << winter << " after stop " << stops;
        ASSERT_TRUE(change(root)) << "after stop " << stops;
        ASSERT_EQ(zoneInForce(root).at(1768435200).offset / 60, newOffset);
    }
    EXPECT_GT(stops, 40); // there were calls to kill at
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
