#include "logger/Write.h"

#include "support/InChild.h"
#include "support/TemporaryDirectory.h"

#include <array>
#include <csignal>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <string>
#include <sys/resource.h>
#include <unistd.h>

using NVLog::writeLine;

namespace {

class Pipe : public testing::Test {
protected:
    Pipe() {
        EXPECT_EQ(pipe2(ends.data(), O_CLOEXEC | O_NONBLOCK), 0);
        EXPECT_GE(fcntl(ends[1], F_SETPIPE_SZ, 4096), 4096);
    }
    ~Pipe() override {
        close(ends[0]);
        close(ends[1]);
    }

    std::string readAll() const {
        std::string text;
        std::array<char, 4096> chunk{};
        for (ssize_t count = 0; (count = read(ends[0], chunk.data(), chunk.size())) > 0;)
            text.append(chunk.data(), static_cast<std::size_t>(count));
        return text;
    }

    std::array<int, 2> ends{};
};

} // namespace

TEST_F(Pipe, TakesALine) {
    EXPECT_TRUE(writeLine(ends[1], "one\n"));
    EXPECT_EQ(readAll(), "one\n");
}

TEST_F(Pipe, IsNotWaitedForWhenFull) {
    const std::string line = std::string(4000, 'x') + "\n";
    EXPECT_TRUE(writeLine(ends[1], line));
    EXPECT_FALSE(writeLine(ends[1], line));
    EXPECT_EQ(readAll(), line);
}

TEST_F(Pipe, HasACutLineEndedBeforeTheNextOne) {
    const std::string longer = std::string(6000, 'x') + "\n"; // more than the pipe holds, so that a part fits
    EXPECT_FALSE(writeLine(ends[1], longer));
    const std::string part = readAll();
    EXPECT_EQ(part, longer.substr(0, part.size()));
    EXPECT_GT(part.size(), 0U);
    EXPECT_TRUE(writeLine(ends[1], "next\n"));
    EXPECT_TRUE(writeLine(ends[1], "after\n"));
    EXPECT_EQ(readAll(), "\nnext\nafter\n");
}

TEST_F(Pipe, WithoutReaderSendsNoSignal) {
    close(ends[0]);
    ends[0] = -1;
    EXPECT_FALSE(writeLine(ends[1], "one\n")); // SIGPIPE would end the test
    sigset_t pending;
    sigpending(&pending);
    EXPECT_EQ(sigismember(&pending, SIGPIPE), 0);
    sigset_t mask;
    pthread_sigmask(SIG_SETMASK, nullptr, &mask);
    EXPECT_EQ(sigismember(&mask, SIGPIPE), 0);
}

TEST(WriteLine, FailsOnAFullDisk) {
    const int full = open("/dev/full", O_WRONLY | O_CLOEXEC);
    if (full < 0) GTEST_SKIP() << "no /dev/full here";
    EXPECT_FALSE(writeLine(full, "one\n"));
    close(full);
}

TEST(WriteLine, FailsOnAClosedDescriptor) {
    EXPECT_FALSE(writeLine(-1, "one\n"));
}

TEST(WriteLine, SurvivesAFileSizeLimit) {
    support::TemporaryDirectory directory;
    const std::string result = support::inChild([&directory] {
        const rlimit limit{6, 6};
        setrlimit(RLIMIT_FSIZE, &limit);
        const int fd = open(directory.path("log").c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0640);
        const bool first = writeLine(fd, "one\n");
        const bool second = writeLine(fd, "second\n"); // SIGXFSZ would end the child
        close(fd);
        return std::string(first ? "whole " : "cut ") + (second ? "whole" : "cut");
    });
    EXPECT_EQ(result, "whole cut");
    EXPECT_EQ(directory.read("log"), "one\nse");
}
