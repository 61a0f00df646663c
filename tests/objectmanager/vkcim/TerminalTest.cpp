#include "objectmanager/vkcim/Terminal.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <cstdlib>

namespace vkcim {
namespace {

TEST(Wrapped, LinesThatFitStayAsTheyAre) {
    EXPECT_EQ(wrapped("", 20), "");
    EXPECT_EQ(wrapped("one two\nthree\n", 20), "one two\nthree\n");
    EXPECT_EQ(wrapped("one two three four five", 0), "one two three four five");
    EXPECT_EQ(wrapped("one two three four f", 20), "one two three four f");
}

TEST(Wrapped, LongLinesAreBrokenAtBlanks) {
    EXPECT_EQ(wrapped("one two three four five\nsix", 20), "one two three four\nfive\nsix");
    EXPECT_EQ(wrapped("    one two three four", 20), "    one two three\n    four");
    EXPECT_EQ(wrapped("  - one two three four", 20), "  - one two three\n    four");
}

TEST(Wrapped, WhatFollowsStandsBelowTheLastColumn) {
    EXPECT_EQ(wrapped("  Name  one two three four", 20), "  Name  one two\n        three four");
    EXPECT_EQ(wrapped("  AVeryLongName  one two three", 20), "  AVeryLongName  one\n  two three")
        << "a column that leaves no room is none";
}

TEST(Wrapped, AWordThatIsTooLongIsBrokenBehindCommas) {
    EXPECT_EQ(wrapped("Class.First=\"a\",Second=\"b\",Third=\"c\"", 27),
              "Class.First=\"a\",Second=\"b\",\n  Third=\"c\"");
    EXPECT_EQ(wrapped("Class.TheOnlyKey=\"a long text\" x", 10), "Class.TheOnlyKey=\"a\nlong text\"\nx");
    const std::string whole(30, 'x');
    EXPECT_EQ(wrapped(whole, 20), whole);
    EXPECT_EQ(wrapped("  Name  " + whole + "\n", 20), "  Name  " + whole + "\n");
    EXPECT_EQ(wrapped("  Name  " + whole + "   ", 20), "  Name  " + whole + "   ");
}

TEST(Wrapped, CharactersCountAndNotBytesOrColours) {
    EXPECT_EQ(wrapped("ää öö üü ßß éé àà ññ", 20), "ää öö üü ßß éé àà ññ");
    EXPECT_EQ(wrapped("one \x1b[1mtwo\x1b[0m three four a", 20), "one \x1b[1mtwo\x1b[0m three four a");
}

class LookTest : public testing::Test {
protected:
    ~LookTest() override {
        for (const char* name : {"LC_ALL", "COLUMNS"}) unsetenv(name);
    }
};

TEST_F(LookTest, TakesTheWidthFromTheEnvironment) {
    setenv("COLUMNS", "100", 1);
    EXPECT_EQ(lookOfStandardOutput().width, 100U);
    setenv("COLUMNS", "3", 1);
    EXPECT_EQ(lookOfStandardOutput().width, 20U) << "less than that can hold nothing";
}

TEST_F(LookTest, BreaksMessagesOnATerminalOnly) {
    const int kept = dup(STDERR_FILENO);
    const auto widthAt = [&](int descriptor) {
        dup2(descriptor, STDERR_FILENO);
        const std::size_t width = widthOfMessages();
        dup2(kept, STDERR_FILENO);
        close(descriptor);
        return width;
    };
    const int master = posix_openpt(O_RDWR | O_NOCTTY);
    ASSERT_EQ(grantpt(master), 0);
    ASSERT_EQ(unlockpt(master), 0);
    const winsize size{.ws_row = 25, .ws_col = 81, .ws_xpixel = 0, .ws_ypixel = 0};
    ASSERT_EQ(ioctl(master, TIOCSWINSZ, &size), 0);
    EXPECT_EQ(widthAt(open(ptsname(master), O_RDWR | O_NOCTTY | O_CLOEXEC)), 81U);
    setenv("COLUMNS", "100", 1);
    EXPECT_EQ(widthAt(open("/dev/null", O_WRONLY | O_CLOEXEC)), 0U) << "a message in a file stays one line";
    close(master);
    close(kept);
}

TEST_F(LookTest, DrawsBoxesInUtf8LocalesOnly) {
    setenv("LC_ALL", "C", 1);
    EXPECT_FALSE(lookOfStandardOutput().boxes);
    setenv("LC_ALL", "C.UTF-8", 1);
    EXPECT_TRUE(lookOfStandardOutput().boxes);
    setenv("LC_ALL", "xx_YY.nothing", 1);
    EXPECT_FALSE(lookOfStandardOutput().boxes);
}

} // namespace
} // namespace vkcim
