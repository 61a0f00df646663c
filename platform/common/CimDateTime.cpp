#include "common/CimDateTime.h"

#include <array>
#include <cstdio>
#include <cstdlib>
#include <ctime>

namespace VK {

namespace {

constexpr std::size_t LENGTH = 25;
constexpr std::size_t FRACTION = 15;
constexpr std::size_t SIGN = 21;

/// Digits only, as many as asked for.
bool number(std::string_view text, std::size_t begin, std::size_t length, int& value) {
    value = 0;
    for (const char c : text.substr(begin, length)) {
        if (c < '0' || c > '9') return false;
        value = value * 10 + (c - '0');
    }
    return true;
}

/// Six digits, of which the last ones may be left open.
bool fraction(std::string_view text, int& value) {
    std::string digits(text);
    for (std::size_t i = digits.size(); i-- > 0 && digits[i] == '*';) digits[i] = '0';
    return number(digits, 0, digits.size(), value);
}

} // namespace

std::optional<Instant> parseCimDateTime(std::string_view text) {
    if (text.size() != LENGTH || text[FRACTION - 1] != '.' || (text[SIGN] != '+' && text[SIGN] != '-'))
        return std::nullopt;
    int year = 0, month = 0, day = 0, hour = 0, minute = 0, second = 0, microsecond = 0, offset = 0;
    const bool digits = number(text, 0, 4, year) && number(text, 4, 2, month) && number(text, 6, 2, day) &&
                        number(text, 8, 2, hour) && number(text, 10, 2, minute) && number(text, 12, 2, second) &&
                        fraction(text.substr(FRACTION, 6), microsecond) && number(text, SIGN + 1, 3, offset);
    if (!digits || hour > 23 || minute > 59 || second > 59) return std::nullopt;
    tm fields{};
    fields.tm_year = year - 1900;
    fields.tm_mon = month - 1;
    fields.tm_mday = day;
    fields.tm_hour = hour;
    fields.tm_min = minute;
    fields.tm_sec = second;
    const std::time_t local = timegm(&fields);
    // A day that does not exist has become another one.
    if (fields.tm_year != year - 1900 || fields.tm_mon != month - 1 || fields.tm_mday != day) return std::nullopt;
    return Instant{std::int64_t{local} - (text[SIGN] == '-' ? -offset : offset) * 60, microsecond};
}

std::string formatCimDateTime(Instant instant, int offsetMinutes) {
    const auto local = static_cast<std::time_t>(instant.seconds + offsetMinutes * 60);
    tm fields{};
    gmtime_r(&local, &fields);
    std::array<char, 64> text{};
    std::snprintf(text.data(), text.size(), "%04d%02d%02d%02d%02d%02d.%06d%c%03d", fields.tm_year + 1900,
                  fields.tm_mon + 1, fields.tm_mday, fields.tm_hour, fields.tm_min, fields.tm_sec,
                  static_cast<int>(instant.microseconds), offsetMinutes < 0 ? '-' : '+', std::abs(offsetMinutes));
    return text.data();
}

} // namespace VK
