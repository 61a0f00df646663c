#include "fuzz/Expect.h"
#include "zone/ZoneFile.h"

#include <algorithm>
#include <cstdint>

namespace {

using namespace VK::Zone;
using fuzz::expect;
using namespace std::literals;

constexpr std::int32_t longestOffset = 26 * 3600; // as zone files may have it

/// Instants to ask for, in order: the ends of time, some that rules change at, and whatever the bytes say at the
/// places where instants may stand, just before and at each.
std::vector<std::int64_t> instantsFor(std::string_view bytes) {
    std::vector<std::int64_t> instants = {INT64_MIN, -1, 0, 1768435200, 1784073600, 253402300800, INT64_MAX};
    for (std::size_t at = 0; at + 8 <= bytes.size() && instants.size() < 200; ++at) {
        std::uint64_t value = 0;
        for (std::size_t i = 0; i < 8; ++i) value = value << 8 | static_cast<unsigned char>(bytes[at + i]);
        const auto instant = static_cast<std::int64_t>(value);
        if (instant == INT64_MIN || std::abs(instant) > std::int64_t{1} << 40) continue;
        instants.push_back(instant - 1);
        instants.push_back(instant);
    }
    std::sort(instants.begin(), instants.end());
    return instants;
}

bool isPossible(std::int32_t offset) {
    return -longestOffset <= offset && offset <= longestOffset;
}

void checkZone(const TimeZone& zone, const std::vector<std::int64_t>& instants) {
    // From the last instant to the first: daylight saving that is still to come has been seen already.
    bool daylightLater = false;
    bool saidLater = false;
    for (auto instant = instants.rbegin(); instant != instants.rend(); ++instant) {
        const TimeZone::LocalTime time = zone.at(*instant);
        const std::int32_t standard = zone.standardOffsetAt(*instant);
        const bool said = zone.hasDaylightSavingFrom(*instant);
        daylightLater = daylightLater || time.daylight;
        expect(isPossible(time.offset) && isPossible(standard), "no such offset");
        expect(time.daylight || standard == time.offset, "outside daylight saving the offset is not the standard one");
        expect(said || !daylightLater, "daylight saving comes although it was said that none would");
        expect(said || !saidLater, "daylight saving was said to come later only");
        saidLater = said;
    }
}

void checkSame(const TimeZone& one, const TimeZone& other, const std::vector<std::int64_t>& instants) {
    for (const std::int64_t instant : instants) {
        const TimeZone::LocalTime time = one.at(instant);
        expect(time.offset == other.at(instant).offset && time.daylight == other.at(instant).daylight,
               "another time the second time");
        expect(one.standardOffsetAt(instant) == other.standardOffsetAt(instant), "another standard offset");
        expect(one.hasDaylightSavingFrom(instant) == other.hasDaylightSavingFrom(instant), "other daylight saving");
    }
}

/// A rule must say the same by itself and at the end of a zone file without transitions.
void checkRule(std::string_view text, const std::vector<std::int64_t>& instants) {
    const auto rule = parsePosixRule(text);
    if (!rule) return;
    for (const std::int64_t instant : instants) {
        const bool daylight = rule->isDaylightAt(instant);
        expect(rule->hasDaylightSaving || !daylight, "daylight saving of a rule that has none");
        expect(rule->offsetAt(instant) == (daylight ? rule->daylightOffset : rule->standardOffset), "a third offset");
    }
    if (text.find('\n') != std::string_view::npos) return; // a file's rule ends there
    const std::string utc = makeZoneFile(0);
    const auto zone = parseZoneFile(utc.substr(0, utc.find('\n') + 1) + std::string(text) + "\n");
    expect(zone.has_value(), "a rule is refused in a file");
    checkZone(*zone, instants);
    for (const std::int64_t instant : instants)
        expect(zone->at(instant).offset == rule->offsetAt(instant), "a rule says something else in a file");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const std::vector<std::int64_t> instants = instantsFor(bytes);
    checkRule(bytes, instants);
    const auto zone = parseZoneFile(bytes);
    const auto again = parseZoneFile(bytes);
    expect(zone.has_value() == again.has_value(), "a zone the second time only");
    if (!zone) return 0;
    checkZone(*zone, instants);
    checkSame(*zone, *again, instants);
    return 0;
}
