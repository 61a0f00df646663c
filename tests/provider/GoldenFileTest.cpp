#include "provider/GoldenFile.h"

#include "support/InChild.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <cstring>

#include <fcntl.h>
#include <pty.h>

namespace {

using testing::HasSubstr;
using testing::StartsWith;

class GoldenFile : public testing::Test {
protected:
    GoldenFile() { directory.write("lines", "one\ntwo\nthree\n"); }

    /// The answer of a process whose standard input is empty, or a terminal at which this is typed.
    std::string compared(const char* setting, const std::vector<std::string>& lines, const char* typed = nullptr) {
        int terminal = -1;
        int keyboard = -1;
        if (typed != nullptr && (openpty(&keyboard, &terminal, nullptr, nullptr, nullptr) != 0 ||
                                 write(keyboard, typed, std::strlen(typed)) < 0))
            return "no terminal";
        const std::string answer = support::inChild([&] {
            const int input = typed != nullptr ? terminal : open("/dev/null", O_RDONLY);
            dup2(input, STDIN_FILENO);
            if (setting != nullptr) setenv("VK_WRITE_TRACES", setting, 1);
            return test::differenceFrom(directory.path("lines"), lines);
        });
        close(terminal);
        close(keyboard);
        return answer;
    }

    const support::TemporaryDirectory directory;
    const std::vector<std::string> changed = {"one", "2", "three", "four"};
};

TEST_F(GoldenFile, OfTheSameLinesDoesNotDiffer) {
    for (const char* setting : {static_cast<const char*>(nullptr), "1", "yes"})
        EXPECT_EQ(compared(setting, {"one", "two", "three"}), "");
}

TEST_F(GoldenFile, SaysWhichLinesDifferAndStays) {
    EXPECT_EQ(compared(nullptr, changed), directory.path("lines") + "\n2 - two\n2 + 2\n4 + four\n");
    EXPECT_THAT(compared(nullptr, {"two", "three"}), HasSubstr("\n1 - one\n"));
    EXPECT_EQ(directory.read("lines"), "one\ntwo\nthree\n");
}

TEST_F(GoldenFile, IsWrittenWithoutATerminalOnlyWhereTheVariableSaysYes) {
    for (const char* setting : {"", "1", "no", "y"})
        EXPECT_THAT(compared(setting, changed), HasSubstr("was not written")) << setting;
    EXPECT_EQ(directory.read("lines"), "one\ntwo\nthree\n");
    EXPECT_EQ(compared("yes", changed), "");
    EXPECT_EQ(directory.read("lines"), "one\n2\nthree\nfour\n");
}

TEST_F(GoldenFile, IsWrittenAtATerminalOnceSomebodyAgrees) {
    for (const char* refusal : {"\n", "n\n", "yellow\n"})
        EXPECT_THAT(compared("1", changed, refusal), HasSubstr("was not written")) << refusal;
    EXPECT_EQ(directory.read("lines"), "one\ntwo\nthree\n");
    EXPECT_EQ(compared("1", changed, "y\n"), "");
    EXPECT_EQ(directory.read("lines"), "one\n2\nthree\nfour\n");
}

TEST_F(GoldenFile, ThatCannotBeWrittenIsAFailure) {
    EXPECT_THAT(test::differenceFrom(directory.path("absent"), {"one"}), StartsWith(directory.path("absent")));
    setenv("VK_WRITE_TRACES", "yes", 1);
    EXPECT_THAT(test::differenceFrom(directory.path("absent/file"), {"one"}), HasSubstr("cannot be written"));
    unsetenv("VK_WRITE_TRACES");
}

} // namespace
