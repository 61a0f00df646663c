#include "common/CimDateTime.h"

#include <gtest/gtest.h>

namespace VK {

namespace {

struct Good {
    const char* text;
    std::int64_t seconds;
    std::int64_t microseconds;
};

TEST(CimDateTime, IsReadWithItsOffset) {
    const Good good[] = {
        {"20240101110000.000000+000", 1704106800, 0},
        {"20240101120000.123456+060", 1704106800, 123456},
        {"20240101060000.000001-300", 1704106800, 1},
        {"20240101110000.******+000", 1704106800, 0},
        {"20240101110000.12****+000", 1704106800, 120000},
        {"20240229000000.000000+000", 1709164800, 0},
        {"19700101000000.000000-000", 0, 0},
        {"19691231235959.000000+000", -1, 0},
        {"99991231235959.999999+999", 253402300799 - 999 * 60, 999999},
    };
    for (const Good& each : good) {
        const auto instant = parseCimDateTime(each.text);
        ASSERT_TRUE(instant.has_value()) << each.text;
        EXPECT_EQ(instant->seconds, each.seconds) << each.text;
        EXPECT_EQ(instant->microseconds, each.microseconds) << each.text;
    }
}

TEST(CimDateTime, OfOtherFormsIsRefused) {
    for (const char* text : {"",
                             "20240101110000",
                             "20240101110000.000000+00",
                             "20240101110000.000000+0000",
                             "20240101110000.000000 000",
                             "20240101110000,000000+000",
                             "00000001132312.000000:000",
                             "20240001000000.000000+000",
                             "20241301000000.000000+000",
                             "20240100000000.000000+000",
                             "20240132000000.000000+000",
                             "20230229000000.000000+000",
                             "20240431000000.000000+000",
                             "20240101240000.000000+000",
                             "20240101006000.000000+000",
                             "20240101000060.000000+000",
                             "202401011100**.******+000",
                             "20240101110000.*00000+000",
                             "20240101110000.000000+***",
                             "+0240101110000.000000+000",
                             "2024010111000a.000000+000",
                             "20240101110000.000000+0 0"})
        EXPECT_FALSE(parseCimDateTime(text).has_value()) << text;
}

TEST(CimDateTime, IsWrittenOnTheClockOfTheOffset) {
    EXPECT_EQ(formatCimDateTime({1704106800, 123456}, 0), "20240101110000.123456+000");
    EXPECT_EQ(formatCimDateTime({1704106800, 1}, 60), "20240101120000.000001+060");
    EXPECT_EQ(formatCimDateTime({1704106800, 0}, -330), "20240101053000.000000-330");
}

} // namespace

} // namespace VK
