#include "zone/PosixRule.h"

#include <algorithm>
#include <cctype>

namespace VK::Zone {

namespace {

using std::chrono::sys_days;
using std::chrono::year;

constexpr std::int64_t longestTime = 167; // hours; what RFC 8536 allows beyond POSIX

/// The year that an instant lies in, in UTC; kept within what a rule can be asked of.
year yearOf(std::int64_t instant) {
    constexpr std::int64_t latest = 253402300799; // 9999-12-31
    const std::chrono::sys_seconds kept{std::chrono::seconds{std::clamp<std::int64_t>(instant, 0, latest)}};
    return std::chrono::year_month_day{std::chrono::floor<std::chrono::days>(kept)}.year();
}

sys_days dayOfMonthRule(const RuleDay& rule, year inYear) {
    const std::chrono::year_month month = inYear / rule.month;
    const std::chrono::weekday weekday{static_cast<unsigned int>(rule.day)};
    if (rule.week == 5) return month / weekday[std::chrono::last];
    return month / weekday[static_cast<unsigned int>(rule.week)];
}

/// Takes a rule's text apart from its front.
class RuleParser {
public:
    explicit RuleParser(std::string_view text) : rest(text) {}

    bool atEnd() const { return rest.empty(); }

    bool take(char c) {
        if (rest.empty() || rest.front() != c) return false;
        rest.remove_prefix(1);
        return true;
    }

    /// An abbreviation, `CET` or `<+0530>`.
    bool name() {
        if (take('<')) {
            const std::size_t end = rest.find('>');
            if (end == std::string_view::npos || end < 3) return false;
            rest.remove_prefix(end + 1);
            return true;
        }
        std::size_t length = 0;
        while (length < rest.size() && std::isalpha(static_cast<unsigned char>(rest[length])) != 0) ++length;
        if (length < 3) return false;
        rest.remove_prefix(length);
        return true;
    }

    bool number(std::int64_t lowest, std::int64_t highest, std::int64_t& value) {
        std::size_t length = 0;
        value = 0;
        while (length < rest.size() && length < 4 && rest[length] >= '0' && rest[length] <= '9')
            value = value * 10 + (rest[length++] - '0');
        rest.remove_prefix(length);
        return length > 0 && lowest <= value && value <= highest;
    }

    /// `[+-]hh[:mm[:ss]]` in seconds.
    bool time(std::int64_t longestHours, std::int64_t& seconds) {
        const bool negative = take('-');
        if (!negative) take('+');
        std::int64_t hours{}, minutes = 0, rest60 = 0;
        if (!number(0, longestHours, hours)) return false;
        if (take(':')) {
            if (!number(0, 59, minutes)) return false;
            if (take(':') && !number(0, 59, rest60)) return false;
        }
        seconds = (hours * 3600 + minutes * 60 + rest60) * (negative ? -1 : 1);
        return true;
    }

    /// `,Mm.w.d[/time]` and the like.
    bool day(RuleDay& rule) {
        if (!take(',')) return false;
        std::int64_t month{}, week{}, day{};
        if (take('M')) {
            if (!number(1, 12, month) || !take('.') || !number(1, 5, week) || !take('.') || !number(0, 6, day))
                return false;
            rule.kind = RuleDay::MonthWeekDay;
        } else {
            rule.kind = take('J') ? RuleDay::Julian : RuleDay::DayOfYear;
            if (!number(rule.kind == RuleDay::Julian ? 1 : 0, 365, day)) return false;
        }
        rule.month = static_cast<int>(month);
        rule.week = static_cast<int>(week);
        rule.day = static_cast<int>(day);
        return !take('/') || time(longestTime, rule.second);
    }

private:
    std::string_view rest;
};

} // namespace

std::int64_t RuleDay::inYear(year which) const {
    const sys_days newYear = which / 1 / 1;
    sys_days found;
    switch (kind) {
    case Julian: // 29 February is never counted
        found = newYear + std::chrono::days{day - 1 + (which.is_leap() && day >= 60 ? 1 : 0)};
        break;
    case DayOfYear:
        found = newYear + std::chrono::days{day};
        break;
    case MonthWeekDay:
        found = dayOfMonthRule(*this, which);
        break;
    }
    return std::chrono::sys_seconds{found}.time_since_epoch().count() + second;
}

bool PosixRule::isDaylightAt(std::int64_t instant) const {
    if (!hasDaylightSaving) return false;
    // As the C library has it: the year of UTC is looked at by itself. Daylight saving of a whole year therefore has
    // its gap between New Year in UTC and New Year in local time, which every program on the host sees.
    const year inForce = yearOf(instant);
    const std::int64_t begins = begin.inYear(inForce) - standardOffset;
    const std::int64_t ends = end.inYear(inForce) - daylightOffset;
    if (begins > ends) return instant < ends || instant >= begins; // over the end of the year
    return begins <= instant && instant < ends;
}

std::optional<PosixRule> parsePosixRule(std::string_view text) {
    constexpr std::int64_t longestOffset = 24;
    PosixRule rule;
    RuleParser parser(text);
    std::int64_t west{};
    if (!parser.name() || !parser.time(longestOffset, west)) return std::nullopt;
    rule.standardOffset = static_cast<std::int32_t>(-west);
    if (parser.atEnd()) return rule;
    rule.hasDaylightSaving = true;
    if (!parser.name()) return std::nullopt;
    std::int64_t daylightWest{};
    RuleParser ahead = parser;
    if (ahead.time(longestOffset, daylightWest))
        parser = ahead;
    else
        daylightWest = west - 3600;
    rule.daylightOffset = static_cast<std::int32_t>(-daylightWest);
    if (!parser.day(rule.begin) || !parser.day(rule.end) || !parser.atEnd()) return std::nullopt;
    return rule;
}

} // namespace VK::Zone
