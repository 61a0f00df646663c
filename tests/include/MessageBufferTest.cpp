#include "include/MessageBuffer.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

namespace {

TEST(MessageBuffer, PrintsNumbersAsSignedDecimals) {
    VK::MessageBuffer buffer{};
    EXPECT_STREQ(buffer.start().addSigned(0).add(" ").addSigned(2147483647U).add(" ").addSigned(2147483648U).finish(),
                 "0 2147483647 -2147483648");
    EXPECT_STREQ(buffer.start().addSigned(UINT_MAX).finish(), "-1");
}

TEST(MessageBuffer, PrintsANullTextAsPrintfDoes) {
    VK::MessageBuffer buffer{};
    EXPECT_STREQ(buffer.start().add("<").add(nullptr).add(">").finish(), "<(null)>");
}

TEST(MessageBuffer, CutsAt511Characters) {
    VK::MessageBuffer buffer{};
    const std::string longText(600, 'x');
    EXPECT_EQ(std::string(buffer.start().add("ab").add(longText.c_str()).add("end").finish()),
              "ab" + std::string(509, 'x'));
    EXPECT_EQ(buffer.text[511], '\0');
}

TEST(MessageBuffer, LeavesNothingOfALongerLineBehind) {
    VK::MessageBuffer buffer{};
    buffer.start().add(std::string(600, 'x').c_str()).finish();
    buffer.start().add("short").finish();
    EXPECT_EQ(std::string(buffer.text, sizeof buffer.text), "short" + std::string(507, '\0'));
}

} // namespace
