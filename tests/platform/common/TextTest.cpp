#include "common/Text.h"

#include <gtest/gtest.h>

namespace VK {

namespace {

using namespace std::literals;

TEST(Text, IsTrimmedAtBothEnds) {
    EXPECT_EQ(trimmed(" \t a b \r\n\0"sv), "a b");
    EXPECT_EQ(trimmed(" \n "), "");
    EXPECT_EQ(trimmed(""), "");
}

TEST(Text, OfTheFirmwareIsPrintableAscii) {
    EXPECT_EQ(cleanText(" a\x01"
                        "b\x7F\x80\xFF~ "),
              "a.b...~");
    EXPECT_EQ(cleanText(std::string(256, 'a') + "b"), std::string(256, 'a'));
    EXPECT_EQ(cleanText(std::string(255, 'a') + " b"), std::string(255, 'a'));
}

TEST(Text, ThatSomebodyWroteKeepsItsLetters) {
    EXPECT_EQ(cleanWrittenText(" J\xC3\xA9r\xC3\xB4me \xE2\x82\xAC \xF0\x9F\x98\x80 "),
              "J\xC3\xA9r\xC3\xB4me \xE2\x82\xAC \xF0\x9F\x98\x80");
    EXPECT_EQ(cleanWrittenText("a\tb\x7F"
                               "c"),
              "a.b.c");
}

TEST(Text, ThatIsNotUtf8BecomesAscii) {
    for (const char* text : {"\xC3", "\xC3(", "\xC0\x80", "\xE0\x80\x80", "\xED\xA0\x80", "\xF0\x80\x80\x80",
                             "\xF4\x90\x80\x80", "\xF5\x80\x80\x80", "\x80", "\xE2\x82"}) {
        const std::string clean = cleanWrittenText("\xC3\xA9"s + text);
        EXPECT_EQ(clean.find_first_not_of(".("), std::string::npos) << clean;
        EXPECT_EQ(clean.size(), 2 + std::string(text).size()) << clean;
    }
}

TEST(Text, IsNeverCutInsideALetter) {
    std::string text;
    while (text.size() < 300) text += "\xE2\x82\xAC";
    EXPECT_EQ(cleanWrittenText(text), text.substr(0, 255));
}

TEST(Text, EndsWithItsFirstLine) {
    EXPECT_EQ(firstLine("a\nb"), "a");
    EXPECT_EQ(firstLine("a\r\nb"), "a");
    EXPECT_EQ(firstLine("a"), "a");
    EXPECT_EQ(firstLine(""), "");
}

} // namespace

} // namespace VK
