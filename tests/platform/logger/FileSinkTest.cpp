// The sink file:PATH.
#include "nvlog/NVLogger.h"

#include "platform/logger/LoggingProcess.h"
#include "support/Allocations.h"
#include "support/TemporaryDirectory.h"

#include <cerrno>
#include <fcntl.h>
#include <gmock/gmock.h>
#include <pthread.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

using logging::Environment;
using logging::log;
using logging::quietly;
using logging::splitLines;
using logging::trace;
using logging::withEnvironment;
using support::TemporaryDirectory;
using testing::ElementsAre;
using testing::EndsWith;
using testing::MatchesRegex;

namespace {

class LogFile : public testing::Test {
protected:
    std::string path() const { return directory.path("vk.log"); }
    std::string text() const { return directory.read("vk.log"); }
    Environment toFile(Environment more = {}) const {
        more["NVLOG_SINK"] = "file:" + path();
        return more;
    }

    TemporaryDirectory directory;
};

} // namespace

TEST_F(LogFile, HoldsOneLineACall) {
    const std::string syslog = withEnvironment(toFile({{"NVLOG_LEVELS", "all"}}), [] {
        log("first\nline\\");
        trace("second", 4000);
    });
    EXPECT_EQ(syslog, "");
    const auto lines = splitLines(text());
    ASSERT_EQ(lines.size(), 2U);
    const std::string time = "[0-9]{4}-[0-9]{2}-[0-9]{2}T[0-9]{2}:[0-9]{2}:[0-9]{2}[.][0-9]{6}Z";
    EXPECT_THAT(lines[0], MatchesRegex(time + " LOG 6000 Norvane[.]Test NVLoggerTest:7 run: first.nline.."));
    EXPECT_THAT(lines[0], EndsWith(" first\\nline\\\\"));
    EXPECT_THAT(lines[1], MatchesRegex(time + " TRACE 4000 Norvane[.]Test NVLoggerTest:7 run: second"));
}

TEST_F(LogFile, HoldsTheLevelsAndChannelsKept) {
    quietly(toFile(), [] {
        for (const int level : {3000, 4000, 6000}) {
            log("log", level);
            trace("trace", level);
        }
    });
    EXPECT_THAT(splitLines(text()), ElementsAre(testing::HasSubstr("LOG 3000"), testing::HasSubstr("TRACE 3000"),
                                                testing::HasSubstr("LOG 6000"), testing::HasSubstr("TRACE 6000")));
}

TEST_F(LogFile, IsMadeForOwnerAndGroupAndClosedOnExec) {
    quietly(toFile(), [this] {
        umask(0);
        log("x");
        struct stat status {};
        ASSERT_EQ(stat(path().c_str(), &status), 0);
        EXPECT_EQ(status.st_mode & 07777, 0640U);
        int kept = 0;
        for (int fd = 0; fd < 100; ++fd) {
            struct stat opened {};
            if (fstat(fd, &opened) != 0 || opened.st_ino != status.st_ino) continue;
            ++kept;
            EXPECT_EQ(fcntl(fd, F_GETFD) & FD_CLOEXEC, FD_CLOEXEC);
            EXPECT_EQ(fcntl(fd, F_GETFL) & O_APPEND, O_APPEND);
        }
        EXPECT_EQ(kept, 1);
    });
}

TEST_F(LogFile, IsAppendedTo) {
    directory.write("vk.log", "before\n");
    quietly(toFile({{"NVLOG_CHANNELS", "log"}}), [] { log("after"); });
    EXPECT_THAT(splitLines(text()), ElementsAre("before", EndsWith("run: after")));
}

TEST_F(LogFile, IsOpenedAgainWhenRotated) {
    quietly(toFile(), [this] {
        log("one");
        rename(path().c_str(), directory.path("vk.log.1").c_str());
        directory.write("vk.log", "");
        log("two");
        log("three");
    });
    EXPECT_THAT(splitLines(directory.read("vk.log.1")), ElementsAre(EndsWith("one")));
    EXPECT_THAT(splitLines(text()), ElementsAre(EndsWith("two"), EndsWith("three")));
}

TEST_F(LogFile, IsMadeAgainWhenItVanished) {
    quietly(toFile(), [this] {
        log("one");
        unlink(path().c_str());
        log("two");
    });
    EXPECT_THAT(splitLines(text()), ElementsAre(EndsWith("two")));
}

TEST_F(LogFile, LeavesStrangersDescriptorsAlone) {
    quietly(toFile(), [this] {
        log("one");
        for (int fd = 3; fd < 100; ++fd) close(fd); // as a daemon does
        const int strangers = open(directory.path("stranger").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0600);
        for (int i = 0; i < 10; ++i) fcntl(strangers, F_DUPFD_CLOEXEC, 3); // the log's number among them
        log("two");
        unlink(path().c_str());
        log("three");
        struct stat status {};
        EXPECT_EQ(fstat(strangers, &status), 0);
        EXPECT_EQ(status.st_size, 0);
        std::_Exit(directory.read("stranger").empty() && splitLines(text()).size() == 1 ? 0 : 1); // the pipe is closed
    });
    EXPECT_THAT(splitLines(text()), ElementsAre(EndsWith("three")));
}

TEST_F(LogFile, IsNeverAStandardStream) {
    quietly(toFile(), [] {
        close(STDIN_FILENO);
        log("one");
        struct stat status {};
        EXPECT_NE(fstat(STDIN_FILENO, &status), 0);
    });
    EXPECT_THAT(splitLines(text()), ElementsAre(EndsWith("one")));
}

TEST_F(LogFile, TakesLinesOfAnyLengthWhole) {
    const std::string text1(5'000'000, 'x');
    quietly(toFile({{"NVLOG_CHANNELS", "log"}}), [&] { log(text1); });
    EXPECT_THAT(text(), EndsWith("run: " + text1 + "\n"));
}

TEST_F(LogFile, TakesWholeLinesFromProcessesAndThreadsAtOnce) {
    constexpr int lineCount = 500;
    const auto write = [](const std::string& name) {
        for (int i = 0; i < lineCount; ++i) log(name + std::string(static_cast<std::size_t>(i) * 3, '.') + "|");
    };
    quietly(toFile({{"NVLOG_CHANNELS", "log"}}), [&] {
        const pid_t other = fork();
        std::vector<std::thread> threads;
        for (int i = 0; i < 4; ++i) threads.emplace_back(write, (other == 0 ? "child" : "parent") + std::to_string(i));
        for (auto& thread : threads) thread.join();
        if (other == 0) std::_Exit(0);
        int status = 0;
        waitpid(other, &status, 0);
    });
    const auto lines = splitLines(text());
    EXPECT_EQ(lines.size(), 8U * lineCount);
    for (const std::string& line : lines)
        ASSERT_THAT(line, MatchesRegex("[-0-9]{10}T[0-9:.]{15}Z LOG 6000 [^ ]+ [^ ]+ run: [a-z]+[0-3][.]*[|]"));
}

TEST_F(LogFile, LosesNoLineWhileRotatedByOthers) {
    constexpr int lineCount = 2000;
    quietly(toFile({{"NVLOG_CHANNELS", "log"}}), [this] {
        std::vector<std::thread> threads;
        for (int i = 0; i < 4; ++i)
            threads.emplace_back([] {
                for (int line = 0; line < lineCount / 4; ++line) log("x");
            });
        for (int i = 0; i < 20; ++i) {
            rename(path().c_str(), directory.path("old" + std::to_string(i)).c_str());
            usleep(500);
        }
        for (auto& thread : threads) thread.join();
    });
    std::size_t count = splitLines(text()).size();
    for (int i = 0; i < 20; ++i) count += splitLines(directory.read("old" + std::to_string(i))).size();
    EXPECT_EQ(count, std::size_t{lineCount});
}

TEST_F(LogFile, KeepsOneDescriptorThroughRotations) {
    quietly(toFile(), [this] {
        log("x");
        const int before = dup(0);
        close(before);
        for (int i = 0; i < 50; ++i) {
            unlink(path().c_str());
            log("x");
        }
        const int after = dup(0);
        close(after);
        EXPECT_EQ(after, before);
    });
}

TEST_F(LogFile, ThatCannotBeOpenedMakesSyslogOfIt) {
    TemporaryDirectory other;
    for (const std::string& path : {other.path("none/vk.log"), other.path()}) {
        const std::string lines = withEnvironment({{"NVLOG_SINK", "file:" + path}}, [] {
            log("failure");
            trace("failure");
            log("notice", 3000);
        });
        EXPECT_EQ(lines, "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: failure\n"
                         "5 LOG 3000 Norvane.Test NVLoggerTest:7 run: notice\n");
    }
}

TEST_F(LogFile, IsUsedAgainOnceItCanBeOpened) {
    const std::string lines =
        withEnvironment({{"NVLOG_SINK", "file:" + directory.path("later/vk.log")}, {"NVLOG_CHANNELS", "log"}}, [this] {
            log("one");
            directory.write("later/other", "");
            log("two");
        });
    EXPECT_EQ(lines, "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: one\n");
    EXPECT_THAT(splitLines(directory.read("later/vk.log")), ElementsAre(EndsWith("two")));
}

TEST(FullDisk, SendsLinesToSyslog) {
    if (access("/dev/full", W_OK) != 0) GTEST_SKIP() << "no /dev/full here";
    EXPECT_EQ(withEnvironment({{"NVLOG_SINK", "file:/dev/full"}, {"NVLOG_CHANNELS", "trace"}}, [] { trace("x"); }),
              "3 TRACE 6000 Norvane.Test NVLoggerTest:7 run: x\n");
}

TEST(FifoWithoutReader, IsNotWaitedFor) {
    TemporaryDirectory directory;
    ASSERT_EQ(mkfifo(directory.path("fifo").c_str(), 0600), 0);
    EXPECT_EQ(withEnvironment({{"NVLOG_SINK", "file:" + directory.path("fifo")}}, [] { log("x"); }),
              "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: x\n");
}

TEST_F(LogFile, CostsNoMemoryAllocationALine) {
    quietly(toFile(), [] {
        const std::string text(200, 'x');
        log(text);
        EXPECT_EQ(support::allocationsDuring([&] {
                      log(text);
                      log(text, 4000);
                      trace(text);
                  }),
                  0U);
    });
}

TEST_F(LogFile, LeavesErrnoAsItWas) {
    quietly(toFile(), [] {
        errno = ERANGE;
        log("x");
        EXPECT_EQ(errno, ERANGE);
    });
}

TEST(UnusableFile, LeavesErrnoAsItWas) {
    const std::string lines = withEnvironment({{"NVLOG_SINK", "file:/none/none"}}, [] {
        errno = ERANGE;
        log("x");
        EXPECT_EQ(errno, ERANGE);
    });
    EXPECT_EQ(lines, "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: x\n");
}

TEST_F(LogFile, OutlivesTheCancellationOfAThread) {
    quietly(toFile({{"NVLOG_CHANNELS", "log"}}), [] {
        std::thread thread([] {
            pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, nullptr);
            pthread_cancel(pthread_self());
            pthread_setcancelstate(PTHREAD_CANCEL_ENABLE, nullptr);
            log("x"); // write and open would be cancelled
            pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, nullptr);
        });
        thread.join();
    });
    EXPECT_THAT(splitLines(text()), ElementsAre(EndsWith("x")));
}
