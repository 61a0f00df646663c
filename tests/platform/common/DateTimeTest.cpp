#include "vk/DateTime.h"

#include <gtest/gtest.h>
#include <limits>

using VK::DateTime;

namespace {

std::string print(long seconds, unsigned int format = 3) {
    return DateTime(seconds, format);
}

} // namespace

TEST(DateTime, PrintsTheInstantInUtc) {
    EXPECT_EQ(print(1704106800), "20240101110000.000000+000");
    EXPECT_EQ(print(0), "19700101000000.000000+000");
    EXPECT_EQ(print(951782399), "20000228235959.000000+000");
    EXPECT_EQ(print(951782400), "20000229000000.000000+000");
    EXPECT_EQ(print(1709251199), "20240229235959.000000+000");
    EXPECT_EQ(print(4107542400), "21000301000000.000000+000");
}

TEST(DateTime, PrintsInstantsBefore1970) {
    EXPECT_EQ(print(-1), "19691231235959.000000+000");
    EXPECT_EQ(print(-86400), "19691231000000.000000+000");
    EXPECT_EQ(print(-2208988800), "19000101000000.000000+000");
}

TEST(DateTime, ReachesFromYear0To9999AndIsEmptyBeyond) {
    EXPECT_EQ(print(-62167219200), "00000101000000.000000+000");
    EXPECT_EQ(print(-62167219201), "");
    EXPECT_EQ(print(253402300799), "99991231235959.000000+000");
    EXPECT_EQ(print(253402300800), "");
    EXPECT_EQ(print(std::numeric_limits<long>::max()), "");
    EXPECT_EQ(print(std::numeric_limits<long>::min()), "");
}

TEST(DateTime, PrintsTheSameInEveryFormat) {
    for (const unsigned int format : {0U, 1U, 2U, 4U, 4294967295U})
        EXPECT_EQ(print(1704106800, format), "20240101110000.000000+000") << format;
}

TEST(DateTime, KeepsNothingButTheInstant) {
    EXPECT_EQ(sizeof(DateTime), sizeof(long));
}

TEST(DateTime, DoesNotDependOnTheTimeZone) {
    setenv("TZ", "Asia/Kolkata", 1);
    EXPECT_EQ(print(1704106800), "20240101110000.000000+000");
    unsetenv("TZ");
}
