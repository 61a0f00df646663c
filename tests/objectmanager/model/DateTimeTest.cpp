#include "objectmanager/model/DateTime.h"

#include <gtest/gtest.h>

namespace om {
namespace {

TEST(DateTimeText, GoodOnes) {
    for (const char* text : {
             "20240101110000.000000+000", // plain
             "20240229235959.999999-720", // leap day
             "20000229000000.000000+999", // leap century, largest offset
             "00000101000000.000000+000", // first year
             "99991231235959.999999+000", // last instant
             "00000000000000.000000:000", // shortest interval
             "99999999235959.999999:000", // longest interval
             "2024010111****.******+000", // hours are known
             "20240101110000.00****+060", // microseconds in part
             "**************.******-060", // nothing is known
         }) {
        EXPECT_TRUE(isDateTime(text)) << text;
    }
}

TEST(DateTimeText, BadOnes) {
    for (const char* text : {
             "",
             "20240101110000.000000+00",   // too short
             "20240101110000.000000+0000", // too long
             "20240101110000,000000+000",  // no point
             "20240101110000.000000 000",  // no sign
             "20240101110000.000000+0x0",  // offset
             "20240001110000.000000+000",  // month 0
             "20241301110000.000000+000",  // month 13
             "20240100110000.000000+000",  // day 0
             "20240431110000.000000+000",  // 31 April
             "20230229110000.000000+000",  // no leap year
             "19000229110000.000000+000",  // no leap century
             "20240101240000.000000+000",  // hour 24
             "20240101116000.000000+000",  // minute 60
             "20240101110060.000000+000",  // second 60
             "2024010111000 .000000+000",  // blank
             "-0240101110000.000000+000",  // sign in the year
             "00000001240000.000000:000",  // hour 24 of an interval
             "00000001000000.000000:001",  // an interval has no offset
             "00000001000000.000000:***",
             "20240101110000.000000+***",
             "202401**110000.000000+000", // known after unknown
             "2024010*110000.000000+000", // half a field
             "20240101110000.0*0000+000",
             "202401011100**.000000+000",
             "********000000.000000:000",
         }) {
        EXPECT_FALSE(isDateTime(text)) << text;
    }
}

struct Instant {
    const char* text;
    std::int64_t microseconds;
};

TEST(DateTimeText, InstantsInMicroseconds) {
    for (const auto& [text, count] : {
             Instant{"19700101000000.000000+000", 0},
             Instant{"19691231235959.999999+000", -1},
             Instant{"20240101110000.000000+000", 1704106800000000},
             Instant{"20240101120000.000000+060", 1704106800000000},
             Instant{"20240101053000.000000-330", 1704106800000000},
             Instant{"20240101001000.000000+720", 1704024600000000}, // the day before, in UTC
             Instant{"20240229235959.123456+000", 1709251199123456},
             Instant{"20240301000000.000000+000", 1709251200000000},
             Instant{"20380119031408.000000+000", 2147483648000000},
             Instant{"00000101000000.000000+000", -62167219200000000},
             Instant{"99991231235959.999999+000", 253402300799999999},
         }) {
        EXPECT_EQ(microseconds(text), count) << text;
    }
}

TEST(DateTimeText, IntervalsInMicroseconds) {
    EXPECT_EQ(microseconds("00000000000000.000001:000"), 1);
    EXPECT_EQ(microseconds("00000001010203.000000:000"), 90123000000);
    EXPECT_EQ(microseconds("99999999235959.999999:000"), 8639999999999999999);
    EXPECT_TRUE(isInterval("00000001010203.000000:000"));
    EXPECT_FALSE(isInterval("20240101110000.000000+000"));
}

TEST(DateTimeText, WhatNamesNoInstantHasNone) {
    EXPECT_EQ(microseconds("20240101110000.00****+000"), std::nullopt);
    EXPECT_EQ(microseconds("20241301110000.000000+000"), std::nullopt);
}

TEST(DateTimeText, FormattingIsTheInverseOfReading) {
    for (const char* text : {"00000101000000.000000+000", "00000229120000.000001+000", "15821015000000.000000+000",
                             "19691231235959.999999+000", "19700101000000.000000+000", "20000229000000.000000+000",
                             "20240229235959.999999+000", "20240301000000.000000+000", "21000228235959.000000+000",
                             "99991231235959.999999+000"}) {
        EXPECT_EQ(formatInstant(*microseconds(text)), text);
    }
    for (const char* text : {"00000000000000.000000:000", "00000365235959.000009:000", "99999999235959.999999:000"}) {
        EXPECT_EQ(formatInterval(static_cast<std::uint64_t>(*microseconds(text))), text);
    }
}

TEST(DateTimeText, EveryDayOfFourCenturiesComesBack) {
    constexpr std::int64_t microsecondsOfDay = 86'400'000'000;
    for (std::int64_t day = -146'097; day <= 146'097; ++day) {
        const auto text = formatInstant(day * microsecondsOfDay);
        ASSERT_TRUE(text && isDateTime(*text)) << day;
        ASSERT_EQ(microseconds(*text), day * microsecondsOfDay) << *text;
    }
}

TEST(DateTimeText, WhatDoesNotFitIsRefused) {
    EXPECT_EQ(formatInstant(253402300800000000), std::nullopt);
    EXPECT_EQ(formatInstant(-62167219200000001), std::nullopt);
    EXPECT_EQ(formatInstant(INT64_MAX), std::nullopt);
    EXPECT_EQ(formatInstant(INT64_MIN), std::nullopt);
    EXPECT_EQ(formatInterval(8640000000000000000U), std::nullopt);
    EXPECT_EQ(formatInterval(UINT64_MAX), std::nullopt);
}

} // namespace
} // namespace om
