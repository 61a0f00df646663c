#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// CIM date-times are texts of 25 characters: `yyyymmddhhmmss.mmmmmmsutc`, digits that are local time at an offset of
/// so many minutes from UTC, or `ddddddddhhmmss.mmmmmm:000` for intervals. Asterisks may stand for the digits that are
/// not significant: whole fields from the right, and any number of digits at the end of the microseconds.
namespace om {

/// Whether the text is a date-time of one kind or the other, every field in its range (a 29 February only in leap
/// years, seconds to 59, offsets to 999 minutes).
bool isDateTime(std::string_view text);

/// Whether a valid date-time is an interval.
bool isInterval(std::string_view dateTime);

/// Microseconds since 1970-01-01 00:00:00 UTC, offset applied, or the length of an interval. Instants before 1970 are
/// negative. Nothing for a text that is not valid, or has asterisks: it names no instant.
std::optional<std::int64_t> microseconds(std::string_view dateTime);

/// The text of an instant, in UTC with `+000`; nothing outside the years 0 to 9999.
std::optional<std::string> formatInstant(std::int64_t microseconds);
/// The text of an interval; nothing above 99999999 days.
std::optional<std::string> formatInterval(std::uint64_t microseconds);

/// The present time in UTC, with microseconds.
std::string formatNow();

} // namespace om
