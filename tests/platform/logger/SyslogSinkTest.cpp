#include "platform/logger/LoggingProcess.h"

#include <cerrno>
#include <gmock/gmock.h>
#include <sys/single_threaded.h>
#include <thread>
#include <unistd.h>

namespace {

using logging::log;
using testing::IsEmpty;

/// What a child of this process sent to syslog, and which of it directly; a child that hangs is killed by SIGALRM.
std::string sentByChild() {
    return support::inChild([] {
        alarm(20);
        log("a%s\nb");
        std::string sent;
        for (const std::string& line : takeSyslog()) sent += "[" + line + "]";
        const std::string self = "<11>" + std::string(program_invocation_short_name) + "[" + std::to_string(getpid());
        for (const std::string& line : takeDirectLines()) sent += line.compare(0, self.size(), self) == 0 ? "d" : "?";
        return sent;
    });
}

const std::string line = "[3 LOG 6000 Norvane.Test NVLoggerTest:7 run: a%s\\nb]";

TEST(SyslogInTheChildOfAFork, IsReachedWithoutTheLockThatAnotherThreadHeld) {
    logging::quietly({}, [] {
        std::thread([] {}).join(); // from now on the C library takes the process for one with threads
        const SyslogIsBusy otherThread;
        EXPECT_EQ(sentByChild(), line + "d");
    });
}

TEST(SyslogInTheChildOfAFork, IsReachedWithoutTheLockInTheChildsOwnChildrenToo) {
    logging::quietly({}, [] {
        std::thread([] {}).join();
        const SyslogIsBusy otherThread;
        EXPECT_EQ(support::inChild(&sentByChild), line + "d");
    });
}

TEST(SyslogInTheChildOfAFork, IsTheCLibrarysWhereNobodyElseCouldHoldItsLock) {
    logging::quietly({}, [] {
        const bool alone = __libc_single_threaded != 0; // a sanitizer may have a thread of its own
        EXPECT_EQ(sentByChild(), alone ? line : line + "d");
    });
}

TEST(SyslogInAProcessWithThreads, IsTheCLibrarys) {
    if (__libc_single_threaded == 0) GTEST_SKIP() << "this process has threads that are not the test's";
    EXPECT_EQ(logging::withEnvironment({},
                                       [] {
                                           std::thread([] { log("x"); }).join();
                                           EXPECT_THAT(takeDirectLines(), IsEmpty());
                                       }),
              "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: x\n");
}

} // namespace
