#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace VK {

/// An instant: seconds since 1970-01-01 00:00:00 UTC, and microseconds of the next one.
struct Instant {
    std::int64_t seconds = 0;
    std::int64_t microseconds = 0;
};

/// Reads a CIM date-time, `yyyymmddhhmmss.mmmmmm±uuu` with the offset in minutes. Microseconds that are left open
/// with asterisks count as zeros. Nothing for intervals, other asterisks and days that do not exist.
std::optional<Instant> parseCimDateTime(std::string_view text);

/// The instant as a CIM date-time on a clock that many minutes east of UTC. The year must have four digits.
std::string formatCimDateTime(Instant instant, int offsetMinutes);

} // namespace VK
