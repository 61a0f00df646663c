#include "zone/PosixRule.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <ctime>

namespace VK::Zone {

namespace {

TEST(PosixRule, OffsetsAreEastOfUtc) {
    EXPECT_EQ(parsePosixRule("UTC0").value().standardOffset, 0);
    EXPECT_EQ(parsePosixRule("CET-1").value().standardOffset, 3600);
    EXPECT_EQ(parsePosixRule("<+0530>-5:30").value().standardOffset, 19800);
    EXPECT_EQ(parsePosixRule("<-1245>+12:45:30").value().standardOffset, -45930);
    EXPECT_FALSE(parsePosixRule("CET-1").value().hasDaylightSaving);
    EXPECT_EQ(parsePosixRule("EST5EDT,M3.2.0,M11.1.0").value().daylightOffset, -14400);
    EXPECT_EQ(parsePosixRule("<+1030>-10:30<+11>-11,M10.1.0,M4.1.0").value().daylightOffset, 39600);
}

TEST(PosixRule, RefusesWhatIsNone) {
    for (const char* text : {"",
                             "0",
                             "U0",
                             "UT0",
                             "UTC",
                             "UTC0 ",
                             "UTC25",
                             "UTC0:60",
                             "<UTC0",
                             "<>0",
                             "<A>0",
                             "UTC-",
                             "UTC:0",
                             "CET-1CEST",
                             "CET-1CEST,M3.5.0",
                             "CET-1CEST,M3.5.0,M10.5.0,",
                             "CET-1CEST,M3.5.0,M10.5.0/168",
                             "CET-1CEST,M13.5.0,M10.5.0",
                             "CET-1CEST,M0.5.0,M10.5.0",
                             "CET-1CEST,M3.6.0,M10.5.0",
                             "CET-1CEST,M3.0.0,M10.5.0",
                             "CET-1CEST,M3.5.7,M10.5.0",
                             "CET-1CEST,J0,J100",
                             "CET-1CEST,J366,J100",
                             "CET-1CEST,366,100",
                             "CET-1CEST,M3.5,M10.5.0",
                             "CET-1CEST,M3.5.0/,M10.5.0",
                             "CET-1CE,M3.5.0,M10.5.0"})
        EXPECT_FALSE(parsePosixRule(text).has_value()) << text;
}

/// The C library reads the same rules.
class AgainstTheLibrary : public testing::TestWithParam<const char*> {
protected:
    ~AgainstTheLibrary() override {
        unsetenv("TZ");
        tzset();
    }
};

TEST_P(AgainstTheLibrary, OffsetsAgreeAllTheYearRound) {
    const PosixRule rule = parsePosixRule(GetParam()).value();
    ASSERT_EQ(setenv("TZ", GetParam(), 1), 0);
    tzset();
    const auto compare = [&rule](std::int64_t instant) {
        const std::time_t time = instant;
        tm local{};
        localtime_r(&time, &local);
        ASSERT_EQ(rule.offsetAt(instant), local.tm_gmtoff) << instant;
        ASSERT_EQ(rule.isDaylightAt(instant), local.tm_isdst > 0) << instant;
    };
    for (std::int64_t instant = 946684800; instant < 1893456000 && !HasFailure(); instant += 10'007) // 2000 to 2030
        compare(instant);
    for (std::int64_t year = 1767225600; year < 1893456000 && !HasFailure(); year += 365 * 86400) // 2026 to 2029
        for (std::int64_t hour = -40; hour < 40 && !HasFailure(); ++hour) compare(year + hour * 3600);
}

INSTANTIATE_TEST_SUITE_P(
    PosixRule, AgainstTheLibrary,
    testing::Values("UTC0", "CET-1CEST,M3.5.0,M10.5.0/3", "EST5EDT,M3.2.0,M11.1.0", "AEST-10AEDT,M10.1.0,M4.1.0/3",
                    "IST-1GMT0,M10.5.0,M3.5.0/1", "<+1030>-10:30<+11>-11,M10.1.0,M4.1.0", "IST-2IDT,M3.4.4/26,M10.5.0",
                    "<-02>2<-01>,M3.5.0/-1,M10.5.0/0", "AAA3BBB,J60/0,J300", "AAA3BBB,59/5,299/0:30",
                    // the whole year, also with a daylight saving that lies west of standard time
                    "EST5EDT,0/0,J365/25", "XXX3EDT4,0/0,J365/23", "AAA-3BBB,0/0,J365/25",
                    // longer than the year, and empty
                    "EST5EDT,0/0,J365/30", "EST5EDT,J1/0,J1/1",
                    // over the ends of years, in local time and in UTC
                    "AAA-3BBB,J1/0,J200", "AAA9BBB,J100,J365/20", "AAA-3BBB,J300,J1/1",
                    "AAA3BBB,M12.5.0/167,M1.1.0/-167", "AAA3BBB,365/0,0/0", "AAA3:30:15BBB2:15,60/2:03:04,J59/-5"));

TEST(PosixRule, DaylightSavingOfTheWholeYearIsDaylightSaving) {
    for (const auto& [text, offset] :
         {std::pair{"EST5EDT,0/0,J365/25", -4 * 3600}, std::pair{"XXX3EDT4,0/0,J365/23", -4 * 3600}}) {
        const PosixRule rule = parsePosixRule(text).value();
        for (const std::int64_t instant : {1768435200, 1784073600, 1798700000}) { // January, July, December 29, 2026
            EXPECT_TRUE(rule.isDaylightAt(instant)) << text << " " << instant;
            EXPECT_EQ(rule.offsetAt(instant), offset) << text << " " << instant;
        }
    }
}

} // namespace

} // namespace VK::Zone
