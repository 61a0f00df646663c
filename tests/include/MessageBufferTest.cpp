#include "include/MessageBuffer.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

namespace {

TEST(MessageBuffer, PrintsNumbersAsSignedDecimals) {
    VK::MessageBuffer buffer{};
    const auto printed = [&](unsigned int number) {
        return std::string(buffer.start().add(VK::SignedDecimal(number)).finish());
    };
    EXPECT_EQ(printed(0), "0");
    EXPECT_EQ(printed(10), "10");
    EXPECT_EQ(printed(2147483647U), "2147483647");
    EXPECT_EQ(printed(2147483648U), "-2147483648");
    EXPECT_EQ(printed(UINT_MAX), "-1");
}

TEST(MessageBuffer, PrintsANullTextAsPrintfDoes) {
    VK::MessageBuffer buffer{};
    EXPECT_STREQ(buffer.start().add("<", static_cast<const char*>(nullptr), ">").finish(), "<(null)>");
}

TEST(MessageBuffer, CutsAt511Characters) {
    VK::MessageBuffer buffer{};
    const std::string longText(600, 'x');
    EXPECT_EQ(std::string(buffer.start().add("ab").add(longText.c_str()).add("end").finish()),
              "ab" + std::string(509, 'x'));
    EXPECT_EQ(buffer.text[511], '\0');
}

TEST(MessageBuffer, TakesALineThatJustFillsIt) {
    VK::MessageBuffer buffer{};
    for (const std::size_t length : {510U, 511U, 512U}) {
        const std::string text(length, 'x');
        EXPECT_EQ(std::string(buffer.start().add(text.c_str()).finish(), 512),
                  std::string(511, 'x').substr(0, length) + std::string(length < 511 ? 2 : 1, '\0'));
    }
}

TEST(MessageBuffer, CutsWithinAPieceAndDropsTheRest) {
    VK::MessageBuffer buffer{};
    const std::string text(509, 'x');
    EXPECT_EQ(std::string(buffer.start().add(text.c_str(), VK::SignedDecimal(123), "end").finish()), text + "12");
}

TEST(MessageBuffer, LeavesNothingOfALongerLineBehind) {
    VK::MessageBuffer buffer{};
    buffer.start().add(std::string(600, 'x').c_str()).finish();
    buffer.start().add("short").finish();
    EXPECT_EQ(std::string(buffer.text, sizeof buffer.text), "short" + std::string(507, '\0'));
}

} // namespace
