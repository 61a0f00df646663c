#include "objectmanager/vkcim/Utf8.h"

#include <gtest/gtest.h>

namespace vkcim {
namespace {

#define REPLACED "\xef\xbf\xbd"

TEST(Utf8, KeepsWhatIsUtf8) {
    for (const char* text :
         {"", "plain", "\xc3\xa9", "\xe2\x82\xac", "\xf0\x9f\x98\x80", "\xf4\x8f\xbf\xbf", "\xed\x9f\xbf"}) {
        EXPECT_EQ(cleanUtf8(text), text);
    }
    EXPECT_EQ(cleanUtf8(std::string_view("a\0b", 3)), std::string("a\0b", 3));
}

TEST(Utf8, ReplacesWhatIsNot) {
    EXPECT_EQ(cleanUtf8("a\xff"
                        "b"),
              "a" REPLACED "b");
    EXPECT_EQ(cleanUtf8("\x80\xbf"), REPLACED REPLACED);
    EXPECT_EQ(cleanUtf8("\xe2\x82"), REPLACED) << "a character cut short";
    EXPECT_EQ(cleanUtf8("\xe2\x82x"), REPLACED "x");
    EXPECT_EQ(cleanUtf8("\xc0\xaf"), REPLACED REPLACED) << "overlong";
    EXPECT_EQ(cleanUtf8("\xed\xa0\x80"), REPLACED REPLACED REPLACED) << "a surrogate";
    EXPECT_EQ(cleanUtf8("\xf4\x90\x80\x80"), REPLACED REPLACED REPLACED REPLACED) << "above U+10FFFF";
}

TEST(Utf8, PrintableTextStaysOnItsLineAndSteersNoTerminal) {
    EXPECT_EQ(printable("a\nb\tc\rd"), "a\\nb\\tc\\rd");
    EXPECT_EQ(printable("\x1b[2J\x7f"), "\\x1b[2J\\x7f");
    EXPECT_EQ(printable("\xc2\x9b"
                        "2J"),
              "\\x9b2J");
    EXPECT_EQ(printable("\xc2\xa0\xc3\xa9\xff"), "\xc2\xa0\xc3\xa9" REPLACED);
}

TEST(Utf8, MessagesKeepTheBeginningAndTheEndOfALongText) {
    EXPECT_EQ(shortened("a\nb"), "a\\nb");
    EXPECT_EQ(shortened(std::string(800, 'x')), std::string(800, 'x'));
    const std::string cut = shortened("path " + std::string(5000000, 'x') + ": position 7");
    EXPECT_EQ(cut.size(), 405u);
    EXPECT_EQ(cut.substr(0, 6), "path x");
    EXPECT_EQ(cut.substr(cut.size() - 13), "x: position 7");
}

} // namespace
} // namespace vkcim
