#pragma once

#include "zone/PosixRule.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace VK::Zone {

/// What a time zone file (TZif) says. Offsets are seconds east of UTC, instants seconds since 1970.
class TimeZone {
public:
    /// A kind of local time.
    struct LocalTime {
        std::int32_t offset = 0;
        bool daylight = false;
    };
    struct Transition {
        std::int64_t instant = 0;
        std::size_t localTime = 0; ///< index of what is in force from then on
    };

    /// UTC.
    TimeZone() : localTimes(1) {}
    TimeZone(std::vector<LocalTime> times, std::vector<Transition> all, std::optional<PosixRule> last)
        : localTimes(std::move(times)), transitions(std::move(all)), rule(last) {}

    /// What is in force at an instant.
    LocalTime at(std::int64_t instant) const;
    /// The offset without daylight saving: the one in force or, during daylight saving, the one that it ends in.
    std::int32_t standardOffsetAt(std::int64_t instant) const;
    /// Whether daylight saving is in force at the instant or comes into force later.
    bool hasDaylightSavingFrom(std::int64_t instant) const;

private:
    std::size_t passedAt(std::int64_t instant) const;

    std::vector<LocalTime> localTimes; ///< never empty
    std::vector<Transition> transitions;
    std::optional<PosixRule> rule; ///< what follows the last transition
};

/// Reads a zone file; nothing unless it is whole and right.
std::optional<TimeZone> parseZoneFile(std::string_view bytes);

/// A zone file (version 2) with one offset at all times, in whole minutes; its zone's name is the offset, `+0530`.
std::string makeZoneFile(std::int32_t offsetMinutes);

} // namespace VK::Zone
