#include "common/CivilTime.h"

#include <ctime>
#include <gtest/gtest.h>

TEST(CivilTime, AgreesWithTheCLibraryOverEightCenturies) {
    // A step that is no whole number of days visits every time of day, month and kind of year.
    for (long seconds = -12'000'000'000; seconds < 13'000'000'000; seconds += 1'000'003) {
        std::tm expected{};
        ASSERT_NE(gmtime_r(&seconds, &expected), nullptr);
        const VK::CivilTime time = VK::civilTime(seconds);
        ASSERT_EQ(time.year, expected.tm_year + 1900L) << seconds;
        ASSERT_EQ(time.month, expected.tm_mon + 1) << seconds;
        ASSERT_EQ(time.day, expected.tm_mday) << seconds;
        ASSERT_EQ(time.hour, expected.tm_hour) << seconds;
        ASSERT_EQ(time.minute, expected.tm_min) << seconds;
        ASSERT_EQ(time.second, expected.tm_sec) << seconds;
    }
}
