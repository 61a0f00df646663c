#include "objectmanager/model/DateTime.h"

#include "objectmanager/model/Characters.h"

#include <algorithm>
#include <chrono>
#include <cstdio>

namespace om {

namespace {

constexpr std::size_t textLength = 25;
constexpr std::size_t pointAt = 14;
constexpr std::size_t microsecondsAt = 15;
constexpr std::size_t signAt = 21;
constexpr std::int64_t million = 1'000'000;
constexpr std::int64_t secondsPerDay = 86'400;

struct Field {
    std::size_t at;
    std::size_t length;
    unsigned least;
    unsigned most;
};

constexpr Field yearField{0, 4, 0, 9999};
constexpr Field monthField{4, 2, 1, 12};
constexpr Field dayField{6, 2, 1, 31};
constexpr Field daysField{0, 8, 0, 99'999'999};
constexpr Field hourField{8, 2, 0, 23};
constexpr Field minuteField{10, 2, 0, 59};
constexpr Field secondField{12, 2, 0, 59};
constexpr Field fractionField{microsecondsAt, 6, 0, 999'999};
constexpr Field offsetField{22, 3, 0, 999};

std::string_view part(std::string_view text, Field field) {
    return text.substr(field.at, field.length);
}

unsigned number(std::string_view text, Field field) {
    unsigned result = 0;
    for (const char c : part(text, field)) result = result * 10 + static_cast<unsigned>(c - '0');
    return result;
}

bool hasDigits(std::string_view text, Field field) {
    const std::string_view digits = part(text, field);
    return std::all_of(digits.begin(), digits.end(), isDigit);
}

bool isUnknown(std::string_view text, Field field) {
    return part(text, field).find_first_not_of('*') == std::string_view::npos;
}

/// A known field in its range, or one that is unknown; after an unknown one no field may be known again.
bool isField(std::string_view text, Field field, bool& unknown) {
    if (isUnknown(text, field)) {
        unknown = true;
        return true;
    }
    if (unknown || !hasDigits(text, field)) return false;
    const unsigned value = number(text, field);
    return value >= field.least && value <= field.most;
}

bool isFraction(std::string_view text, bool unknown) {
    const std::string_view digits = part(text, fractionField);
    const std::size_t known = std::min(digits.find('*'), digits.size());
    return std::all_of(digits.begin(), digits.begin() + static_cast<std::ptrdiff_t>(known), isDigit) &&
           digits.find_first_not_of('*', known) == std::string_view::npos && (!unknown || known == 0);
}

std::chrono::year_month_day dateOf(std::string_view text) {
    return {std::chrono::year{static_cast<int>(number(text, yearField))}, std::chrono::month{number(text, monthField)},
            std::chrono::day{number(text, dayField)}};
}

bool dayExists(std::string_view text) {
    if (isUnknown(text, dayField)) return true;
    return dateOf(text).ok();
}

std::string print(std::int64_t days, std::int64_t secondOfDay, std::int64_t fraction) {
    char time[32];
    std::snprintf(time, sizeof time, "%02d%02d%02d.%06d", static_cast<int>(secondOfDay / 3600),
                  static_cast<int>(secondOfDay / 60 % 60), static_cast<int>(secondOfDay % 60),
                  static_cast<int>(fraction));
    char date[32];
    std::snprintf(date, sizeof date, "%08d", static_cast<int>(days));
    return std::string(date) + time;
}

std::int64_t floorDivide(std::int64_t a, std::int64_t b) {
    return a / b - (a % b < 0 ? 1 : 0);
}

} // namespace

bool isInterval(std::string_view dateTime) {
    return dateTime.size() == textLength && dateTime[signAt] == ':';
}

bool isDateTime(std::string_view text) {
    if (text.size() != textLength || text[pointAt] != '.') return false;
    bool unknown = false;
    const bool interval = isInterval(text);
    if (interval ? !isField(text, daysField, unknown)
                 : !isField(text, yearField, unknown) || !isField(text, monthField, unknown) ||
                       !isField(text, dayField, unknown) || !dayExists(text)) {
        return false;
    }
    if (!isField(text, hourField, unknown) || !isField(text, minuteField, unknown) ||
        !isField(text, secondField, unknown) || !isFraction(text, unknown)) {
        return false;
    }
    if (interval) return part(text, offsetField) == "000";
    return (text[signAt] == '+' || text[signAt] == '-') && hasDigits(text, offsetField);
}

std::optional<std::int64_t> microseconds(std::string_view dateTime) {
    if (!isDateTime(dateTime) || dateTime.find('*') != std::string_view::npos) return std::nullopt;
    const auto value = [dateTime](Field field) { return static_cast<std::int64_t>(number(dateTime, field)); };
    const std::int64_t time = (value(hourField) * 60 + value(minuteField)) * 60 + value(secondField);
    std::int64_t seconds = 0;
    if (isInterval(dateTime)) {
        seconds = value(daysField) * secondsPerDay + time;
    } else {
        const std::int64_t offset = value(offsetField) * (dateTime[signAt] == '-' ? -60 : 60);
        const std::int64_t days = std::chrono::sys_days{dateOf(dateTime)}.time_since_epoch().count();
        seconds = days * secondsPerDay + time - offset;
    }
    return seconds * million + value(fractionField);
}

std::optional<std::string> formatInstant(std::int64_t microseconds) {
    const std::int64_t seconds = floorDivide(microseconds, million);
    const std::int64_t days = floorDivide(seconds, secondsPerDay);
    constexpr std::int64_t earliest = -719'528; // 0000-01-01
    constexpr std::int64_t latest = 2'932'896;  // 9999-12-31
    if (days < earliest || days > latest) return std::nullopt;
    const std::chrono::year_month_day date{std::chrono::sys_days{std::chrono::days{days}}};
    const std::int64_t packed =
        (std::int64_t{int{date.year()}} * 100 + unsigned{date.month()}) * 100 + unsigned{date.day()};
    return print(packed, seconds - days * secondsPerDay, microseconds - seconds * million) + "+000";
}

std::optional<std::string> formatInterval(std::uint64_t microseconds) {
    constexpr auto perSecond = static_cast<std::uint64_t>(million);
    constexpr auto perDay = static_cast<std::uint64_t>(secondsPerDay) * perSecond;
    const std::uint64_t days = microseconds / perDay;
    if (days > daysField.most) return std::nullopt;
    return print(static_cast<std::int64_t>(days), static_cast<std::int64_t>(microseconds % perDay / perSecond),
                 static_cast<std::int64_t>(microseconds % perSecond)) +
           ":000";
}

std::string formatNow() {
    const auto now = std::chrono::system_clock::now().time_since_epoch();
    const auto count = std::chrono::duration_cast<std::chrono::microseconds>(now).count();
    return formatInstant(count).value_or("19700101000000.000000+000");
}

} // namespace om
