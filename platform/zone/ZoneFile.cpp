#include "zone/ZoneFile.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>

namespace VK::Zone {

using namespace std::literals;

namespace {

constexpr std::size_t headerSize = 44;
constexpr std::size_t localTimeSize = 6;

/// How many of each kind of record a block holds, in the order of the header.
struct Counts {
    std::size_t utIndicators, standardIndicators, leapSeconds, transitions, localTimes, nameBytes;
};

std::int64_t bigEndian(std::string_view bytes, std::size_t offset, std::size_t length) {
    // The first byte's top bit is the sign.
    std::uint64_t value = (static_cast<unsigned char>(bytes[offset]) & 0x80) != 0 ? ~std::uint64_t{0} : 0;
    for (std::size_t i = 0; i < length; ++i) value = value << 8 | static_cast<unsigned char>(bytes[offset + i]);
    return static_cast<std::int64_t>(value);
}

std::optional<Counts> readHeader(std::string_view bytes) {
    if (bytes.size() < headerSize || bytes.substr(0, 4) != "TZif"sv) return std::nullopt;
    std::size_t counts[6];
    for (std::size_t i = 0; i < 6; ++i) {
        const std::int64_t count = bigEndian(bytes, 20 + 4 * i, 4);
        if (count < 0 || count > static_cast<std::int64_t>(bytes.size())) return std::nullopt;
        counts[i] = static_cast<std::size_t>(count);
    }
    return Counts{counts[0], counts[1], counts[2], counts[3], counts[4], counts[5]};
}

std::size_t blockSize(const Counts& counts, std::size_t timeSize) {
    return counts.transitions * (timeSize + 1) + counts.localTimes * localTimeSize + counts.nameBytes +
           counts.leapSeconds * (timeSize + 4) + counts.standardIndicators + counts.utIndicators;
}

std::optional<std::vector<TimeZone::LocalTime>> readLocalTimes(std::string_view bytes, std::size_t count) {
    std::vector<TimeZone::LocalTime> result;
    for (std::size_t i = 0; i < count; ++i) {
        const std::int64_t offset = bigEndian(bytes, localTimeSize * i, 4);
        constexpr std::int64_t longest = 26 * 3600; // as zone files may have it
        if (offset < -longest || offset > longest) return std::nullopt;
        result.push_back({static_cast<std::int32_t>(offset), bytes[localTimeSize * i + 4] != 0});
    }
    return result;
}

/// The line between two line ends behind the last block; a zone may have no rule.
bool readRule(std::string_view footer, std::optional<PosixRule>& rule) {
    const std::size_t end = footer.find('\n', 1);
    if (footer.empty() || footer.front() != '\n' || end == std::string_view::npos) return false;
    if (end == 1) return true;
    rule = parsePosixRule(footer.substr(1, end - 1));
    return rule.has_value();
}

/// Reads the block behind a header; `footer` is what follows it, for files that have one.
std::optional<TimeZone> readBlock(std::string_view bytes, const Counts& counts, std::size_t timeSize, bool hasFooter) {
    if (counts.localTimes == 0 || counts.localTimes > 256 || blockSize(counts, timeSize) > bytes.size())
        return std::nullopt;
    const std::string_view indexes = bytes.substr(counts.transitions * timeSize);
    auto localTimes = readLocalTimes(indexes.substr(counts.transitions), counts.localTimes);
    if (!localTimes) return std::nullopt;
    std::vector<TimeZone::Transition> transitions;
    for (std::size_t i = 0; i < counts.transitions; ++i) {
        const TimeZone::Transition each{bigEndian(bytes, timeSize * i, timeSize),
                                        static_cast<unsigned char>(indexes[i])};
        if (each.localTime >= localTimes->size()) return std::nullopt;
        if (!transitions.empty() && each.instant <= transitions.back().instant) return std::nullopt;
        transitions.push_back(each);
    }
    std::optional<PosixRule> rule;
    if (hasFooter && !readRule(bytes.substr(blockSize(counts, timeSize)), rule)) return std::nullopt;
    return TimeZone(std::move(*localTimes), std::move(transitions), rule);
}

} // namespace

std::size_t TimeZone::passedAt(std::int64_t instant) const {
    const auto next = std::upper_bound(transitions.begin(), transitions.end(), instant,
                                       [](std::int64_t value, const Transition& each) { return value < each.instant; });
    return static_cast<std::size_t>(next - transitions.begin());
}

TimeZone::LocalTime TimeZone::at(std::int64_t instant) const {
    const std::size_t passed = passedAt(instant);
    if (passed == transitions.size() && rule) return {rule->offsetAt(instant), rule->isDaylightAt(instant)};
    return localTimes[passed == 0 ? 0 : transitions[passed - 1].localTime];
}

std::int32_t TimeZone::standardOffsetAt(std::int64_t instant) const {
    const LocalTime now = at(instant);
    if (!now.daylight) return now.offset;
    const std::size_t passed = passedAt(instant);
    for (std::size_t i = passed; i < transitions.size(); ++i)
        if (const LocalTime& next = localTimes[transitions[i].localTime]; !next.daylight) return next.offset;
    if (rule) return rule->standardOffset;
    for (std::size_t i = passed; i > 0; --i)
        if (const LocalTime& before = localTimes[transitions[i - 1].localTime]; !before.daylight) return before.offset;
    return now.offset;
}

bool TimeZone::hasDaylightSavingFrom(std::int64_t instant) const {
    if (at(instant).daylight || (rule && rule->hasDaylightSaving)) return true;
    for (std::size_t i = passedAt(instant); i < transitions.size(); ++i)
        if (localTimes[transitions[i].localTime].daylight) return true;
    return false;
}

std::optional<TimeZone> parseZoneFile(std::string_view bytes) {
    const std::optional<Counts> first = readHeader(bytes);
    if (!first) return std::nullopt;
    const std::size_t firstSize = blockSize(*first, 4);
    if (firstSize > bytes.size() - headerSize) return std::nullopt;
    if (bytes[4] == '\0') return readBlock(bytes.substr(headerSize), *first, 4, false);
    // From version 2 on a second block with 64-bit instants follows, and the rule.
    const std::string_view second = bytes.substr(headerSize + firstSize);
    const std::optional<Counts> counts = readHeader(second);
    return counts ? readBlock(second.substr(headerSize), *counts, 8, true) : std::nullopt;
}

std::string makeZoneFile(std::int32_t offsetMinutes) {
    const int hours = std::abs(offsetMinutes) / 60;
    const int minutes = std::abs(offsetMinutes) % 60;
    char name[16], west[16];
    std::snprintf(name, sizeof name, "%c%02d%02d", offsetMinutes < 0 ? '-' : '+', hours, minutes);
    std::snprintf(west, sizeof west, minutes != 0 ? "%s%d:%02d" : "%s%d", offsetMinutes > 0 ? "-" : "", hours, minutes);
    if (minutes == 0) name[3] = '\0';

    const std::string names = std::string(name) + '\0';
    const auto seconds = static_cast<std::uint32_t>(offsetMinutes * 60);
    std::string header = "TZif2" + std::string(15 + 4 * 4, '\0'); // no indicators, leap seconds or transitions
    header += "\0\0\0\1"s + "\0\0\0"s + static_cast<char>(names.size());
    std::string block;
    for (int shift = 24; shift >= 0; shift -= 8) block += static_cast<char>(seconds >> shift & 0xFF);
    block += "\0\0"s + names; // no daylight saving; the name is the first one
    // The block has no instants: it is the same for both versions.
    return header + block + header + block + "\n<" + name + ">" + west + "\n";
}

} // namespace VK::Zone
