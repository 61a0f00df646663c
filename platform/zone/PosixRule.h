#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string_view>

namespace VK::Zone {

/// A day of the year as a time zone rule names it, and the second of that day.
struct RuleDay {
    enum Kind { Julian, DayOfYear, MonthWeekDay } kind = MonthWeekDay;
    int day = 0; ///< Julian: 1 to 365, never counting February 29; DayOfYear: 0 to 365; else the weekday, Sunday 0
    int week = 0;
    int month = 0;
    std::int64_t second = 7200; ///< of local time; may lie in other days

    /// When it comes in a year, in seconds since 1970 as if local time were UTC.
    std::int64_t inYear(std::chrono::year which) const;
};

/// A POSIX time zone rule such as `CET-1CEST,M3.5.0,M10.5.0/3`. Offsets are seconds east of UTC.
struct PosixRule {
    std::int32_t standardOffset = 0;
    bool hasDaylightSaving = false;
    std::int32_t daylightOffset = 0;
    RuleDay begin; ///< of daylight saving
    RuleDay end;

    /// Whether daylight saving is in force at an instant, as the C library says.
    bool isDaylightAt(std::int64_t instant) const;
    std::int32_t offsetAt(std::int64_t instant) const {
        return isDaylightAt(instant) ? daylightOffset : standardOffset;
    }
};

/// Reads a rule; nothing for texts that are none. A rule with daylight saving must say when it begins and ends.
std::optional<PosixRule> parsePosixRule(std::string_view text);

} // namespace VK::Zone
