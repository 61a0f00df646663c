#include "zone/Clock.h"

#include "support/LogCapture.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cerrno>
#include <cstdlib>
#include <ctime>
#include <unistd.h>

namespace VK::Zone {

namespace {

using support::takeLog;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

TEST(Clock, TakesOnlyDateTimesFrom2000On) {
    Instant instant;
    EXPECT_EQ(checkClockText("20240101120000.250000+060", instant), "");
    EXPECT_EQ(instant.seconds, 1704106800);
    EXPECT_EQ(instant.microseconds, 250000);
    EXPECT_EQ(checkClockText("20000101000000.000000+000", instant), "");
    EXPECT_EQ(checkClockText("20000101000000.000000+060", instant), "\"20000101000000.000000+060\" lies before 2000");
    EXPECT_EQ(checkClockText("00000001132312.000000:000", instant), "\"00000001132312.000000:000\" is no date-time");
    EXPECT_EQ(checkClockText("", instant), "\"\" is no date-time");
}

TEST(Clock, OfASnapshotCannotBeSet) {
    const support::TemporaryDirectory directory;
    takeLog();
    EXPECT_FALSE(changeClock(Root(directory.path()), "20240101120000.000000+000"));
    EXPECT_THAT(takeLog(), ElementsAre("6000 clock not set: a snapshot has none"));
}

TEST(Clock, RefusesBadTextsWithOneLogLine) {
    takeLog();
    EXPECT_FALSE(changeClock(Root("/"), "tomorrow"));
    EXPECT_THAT(takeLog(), ElementsAre("6000 clock not set: \"tomorrow\" is no date-time"));
    EXPECT_FALSE(changeClock(Root("/"), "19991231235959.999999+000"));
    EXPECT_THAT(takeLog(), ElementsAre(HasSubstr("lies before 2000")));
}

std::string nowText() {
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    return formatCimDateTime({now.tv_sec, now.tv_nsec / 1000}, 330);
}

TEST(Clock, WithoutThePrivilegeTheLogNamesIt) {
    if (geteuid() != 0) GTEST_SKIP() << "takes root, to become somebody else";
    const auto asNobody = [] {
        takeLog();
        if (setgid(65534) != 0 || setuid(65534) != 0) _exit(10);
        if (changeClock(Root("/"), nowText())) _exit(11);
        const std::vector<std::string> log = takeLog();
        _exit(log.size() == 1 && log[0].find("CAP_SYS_TIME") != std::string::npos ? 0 : 12);
    };
    EXPECT_EXIT(asNobody(), testing::ExitedWithCode(0), "");
}

double seconds(clockid_t clock) {
    timespec time{};
    clock_gettime(clock, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) / 1e9;
}

TEST(Clock, SetToNowStaysWhereItIs) {
    if (std::getenv("VK_TEST_CLOCK") == nullptr)
        GTEST_SKIP() << "the machine's clocks are set, to now, only where VK_TEST_CLOCK is in the environment";
    takeLog();
    const double before = seconds(CLOCK_REALTIME) - seconds(CLOCK_MONOTONIC);
    const bool done = changeClock(Root("/"), nowText());
    const double after = seconds(CLOCK_REALTIME) - seconds(CLOCK_MONOTONIC);
    const std::vector<std::string> log = takeLog();
    if (!done && log.size() == 1 && log[0].find("CAP_SYS_TIME") != std::string::npos)
        GTEST_SKIP() << "setting the clock is not allowed here: " << log[0];
    EXPECT_TRUE(done);
    EXPECT_NEAR(before, after, 0.05);
    ASSERT_GE(log.size(), 1U);
    EXPECT_THAT(log.back(), StartsWith("3000 clock set from 20"));
    EXPECT_THAT(log.back(), HasSubstr("by uid " + std::to_string(getuid())));
}

std::string text(const tm& time) {
    char result[32];
    strftime(result, sizeof result, "%F %T", &time);
    return result;
}

TEST(Clock, HardwareClocksKeepUtcOrLocalTime) {
    EXPECT_EQ(text(hardwareClockTime({1704106800, 499'999}, 0)), "2024-01-01 11:00:00");
    EXPECT_EQ(text(hardwareClockTime({1704106800, 500'000}, 0)), "2024-01-01 11:00:01");
    EXPECT_EQ(text(hardwareClockTime({1704106800, 0}, 19800)), "2024-01-01 16:30:00");
}

TEST(Adjtime, ThirdLineSaysHowTheHardwareClockRuns) {
    EXPECT_TRUE(adjtimeSaysLocal("0.0 0 0.0\n0\nLOCAL\n"));
    EXPECT_TRUE(adjtimeSaysLocal("0.0 0 0.0\n0\nLOCAL"));
    for (const char* text : {"0.0 0 0.0\n0\nUTC\n", "0.0 0 0.0\n0\n", "LOCAL\n", "", "\n\n\nLOCAL"})
        EXPECT_FALSE(adjtimeSaysLocal(text)) << text;
}

} // namespace

} // namespace VK::Zone
