#include "common/CimDateTime.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstddef>
#include <cstdio>
#include <cstdlib>

namespace VK {

namespace {

constexpr std::size_t wholeLength = 25;
constexpr std::size_t fractionAt = 15;
constexpr std::size_t signAt = 21;

/// Digits only, as many as asked for.
bool number(std::string_view text, std::size_t begin, std::size_t length, int& value) {
    value = 0;
    for (const char c : text.substr(begin, length)) {
        if (c < '0' || c > '9') return false;
        value = value * 10 + (c - '0');
    }
    return true;
}

/// Six digits; asterisks may stand for the last ones.
bool fraction(std::string_view text, int& value) {
    std::string digits(text);
    const std::size_t known = text.find_last_not_of('*') + 1; // 0 where all are asterisks
    std::fill(digits.begin() + static_cast<std::ptrdiff_t>(known), digits.end(), '0');
    return number(digits, 0, digits.size(), value);
}

} // namespace

std::optional<Instant> parseCimDateTime(std::string_view text) {
    if (text.size() != wholeLength || text[fractionAt - 1] != '.' || (text[signAt] != '+' && text[signAt] != '-'))
        return std::nullopt;
    int year{}, month{}, day{}, hour{}, minute{}, second{}, microsecond{}, offset{};
    const bool digits = number(text, 0, 4, year) && number(text, 4, 2, month) && number(text, 6, 2, day) &&
                        number(text, 8, 2, hour) && number(text, 10, 2, minute) && number(text, 12, 2, second) &&
                        fraction(text.substr(fractionAt, 6), microsecond) && number(text, signAt + 1, 3, offset);
    if (!digits || hour > 23 || minute > 59 || second > 59) return std::nullopt;
    const std::chrono::year_month_day date{std::chrono::year{year}, std::chrono::month{static_cast<unsigned>(month)},
                                           std::chrono::day{static_cast<unsigned>(day)}};
    if (!date.ok()) return std::nullopt;
    const std::int64_t days = std::chrono::sys_days{date}.time_since_epoch().count();
    const std::int64_t local = days * 86400 + hour * 3600 + minute * 60 + second;
    return Instant{local - (text[signAt] == '-' ? -offset : offset) * 60, microsecond};
}

std::string formatCimDateTime(Instant instant, int offsetMinutes) {
    using namespace std::chrono;
    const sys_seconds local{seconds{instant.seconds + offsetMinutes * 60}};
    const auto midnight = floor<days>(local);
    const year_month_day date{midnight};
    const hh_mm_ss time{local - midnight};
    std::array<char, 64> text{};
    std::snprintf(text.data(), text.size(), "%04d%02u%02u%02ld%02ld%02ld.%06d%c%03d", int{date.year()},
                  unsigned{date.month()}, unsigned{date.day()}, long{time.hours().count()},
                  long{time.minutes().count()}, long{time.seconds().count()}, static_cast<int>(instant.microseconds),
                  offsetMinutes < 0 ? '-' : '+', std::abs(offsetMinutes));
    return text.data();
}

} // namespace VK
