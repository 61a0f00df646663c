#include "Linux/CommandStream.h"
#include "support/Isolated.h"
#include "support/TemporaryDirectory.h"

#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <string>
#include <sys/resource.h>

namespace {

using VK::BaseServerProvider::CommandStream;

/// What is read with a buffer of 16 bytes, or `(end)`.
std::string readFrom(CommandStream& stream) {
    char buffer[16] = {};
    return stream.readLine(buffer, sizeof buffer) ? buffer : "(end)";
}

TEST(CommandStream, ReadsLineByLineWithTheLineFeed) {
    CommandStream stream("printf 'one\\ntwo\\nlast'", "r");
    ASSERT_TRUE(static_cast<bool>(stream));
    EXPECT_EQ(readFrom(stream), "one\n");
    EXPECT_EQ(readFrom(stream), "two\n");
    EXPECT_EQ(readFrom(stream), "last");
    EXPECT_EQ(readFrom(stream), "(end)");
}

TEST(CommandStream, CutsALineThatDoesNotFit) {
    CommandStream stream("echo 0123456789abcdefgh", "r");
    EXPECT_EQ(readFrom(stream), "0123456789abcde");
    EXPECT_EQ(readFrom(stream), "fgh\n");
}

TEST(CommandStream, LeavesTheBufferAloneAtTheEnd) {
    CommandStream stream("true", "r");
    char buffer[16] = "before";
    EXPECT_FALSE(stream.readLine(buffer, sizeof buffer));
    EXPECT_STREQ(buffer, "before");
}

TEST(CommandStream, WasStartedEvenIfTheShellFindsNoSuchCommand) {
    CommandStream stream("/nonexistent/command 2>/dev/null", "r");
    EXPECT_TRUE(static_cast<bool>(stream));
    EXPECT_EQ(readFrom(stream), "(end)");
}

TEST(CommandStream, IsFalseWhenTheProcessHasNoDescriptorLeft) {
    test::isolated([] {
        const rlimit none = {0, 0};
        ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &none), 0);
        EXPECT_FALSE(static_cast<bool>(CommandStream("echo text", "r")));
    });
}

TEST(CommandStream, WaitsForItsCommandSoThatNoZombieStays) {
    test::isolated([] {
        { CommandStream stream("exit 3", "r"); }
        EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1);
        EXPECT_EQ(errno, ECHILD);
    });
}

TEST(CommandStream, EndsACommandThatHasMoreToSay) {
    CommandStream stream("yes", "r");
    EXPECT_EQ(readFrom(stream), "y\n");
}

TEST(CommandStream, EndsACommandThatHasMoreToSayAlsoWithSigpipeIgnored) {
    test::isolated([] {
        std::signal(SIGPIPE, SIG_IGN);
        CommandStream stream("yes 2>/dev/null", "r");
        EXPECT_EQ(readFrom(stream), "y\n");
    });
}

TEST(CommandStream, ReadsAsUsualWithSigchldIgnored) {
    test::isolated([] {
        std::signal(SIGCHLD, SIG_IGN);
        CommandStream stream("echo text|cat", "r");
        EXPECT_EQ(readFrom(stream), "text\n");
    });
}

TEST(CommandStream, IsNotInheritedByOtherCommands) {
    const support::TemporaryDirectory directory;
    const std::string list = "ls /proc/self/fd >" + directory.path("open") + " && mv " + directory.path("open") + " ";
    ASSERT_EQ(std::system((list + directory.path("without")).c_str()), 0);
    CommandStream stream("echo text", "r");
    ASSERT_EQ(std::system((list + directory.path("with")).c_str()), 0);
    EXPECT_EQ(directory.read("with"), directory.read("without"));
    EXPECT_NE(directory.read("without"), "");
}

} // namespace
