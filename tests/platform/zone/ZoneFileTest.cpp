#include "zone/ZoneFile.h"

#include "support/InChild.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <iterator>

namespace VK::Zone {

namespace {

using namespace std::literals;

constexpr std::int64_t winter2026 = 1768435200; // January 15
constexpr std::int64_t summer2026 = 1784073600; // July 15

std::string zoneBytes(const std::string& name) {
    std::ifstream file("/usr/share/zoneinfo/" + name, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

TimeZone zone(const std::string& name) {
    return parseZoneFile(zoneBytes(name)).value();
}

struct Expected {
    const char* name;
    std::int32_t winter, summer, standard;
    bool daylight;
};

TEST(ZoneFile, TellsOffsetsAndDaylightSaving) {
    const Expected zones[] = {
        {"Europe/Berlin", 3600, 7200, 3600, true},
        {"America/New_York", -18000, -14400, -18000, true},
        {"Australia/Adelaide", 37800, 34200, 34200, true},
        {"Asia/Kolkata", 19800, 19800, 19800, false},
        {"Etc/UTC", 0, 0, 0, false},
        {"Etc/GMT-1", 3600, 3600, 3600, false},
        {"Pacific/Kiritimati", 50400, 50400, 50400, false},
    };
    for (const Expected& each : zones) {
        const TimeZone read = zone(each.name);
        EXPECT_EQ(read.at(winter2026).offset, each.winter) << each.name;
        EXPECT_EQ(read.at(summer2026).offset, each.summer) << each.name;
        EXPECT_EQ(read.standardOffsetAt(winter2026), each.standard) << each.name;
        EXPECT_EQ(read.standardOffsetAt(summer2026), each.standard) << each.name;
        EXPECT_EQ(read.hasDaylightSavingFrom(summer2026), each.daylight) << each.name;
    }
}

TEST(ZoneFile, StandardTimeIsWhatTheZoneCallsSo) {
    // Ireland's standard time is that of summer: in winter it saves daylight the other way round.
    EXPECT_EQ(zone("Europe/Dublin").standardOffsetAt(winter2026), 3600);
    EXPECT_TRUE(zone("Europe/Dublin").hasDaylightSavingFrom(winter2026));
}

TEST(ZoneFile, DaylightSavingThatIsOverIsNone) {
    const TimeZone japan = zone("Asia/Tokyo");
    EXPECT_TRUE(japan.hasDaylightSavingFrom(-700000000)); // 1947, with some to come
    EXPECT_FALSE(japan.hasDaylightSavingFrom(winter2026));
}

/// Every installed zone, by its name.
std::vector<std::string> installedZones() {
    const std::filesystem::path directory = "/usr/share/zoneinfo";
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(directory)) {
        const std::string name = entry.path().lexically_relative(directory);
        if (entry.is_regular_file() && zoneBytes(name).substr(0, 4) == "TZif") names.push_back(name);
    }
    return names;
}

/// The first instant at which the C library has other local time in a zone; nothing when there is none.
std::string firstDifference(const std::string& name) {
    const TimeZone read = zone(name);
    setenv("TZ", (":"s + name).c_str(), 1);
    tzset();
    for (std::int64_t instant = 0; instant < 4102444800; instant += 3'000'017) { // 1970 to 2100
        const std::time_t time = instant;
        tm local{};
        localtime_r(&time, &local);
        const TimeZone::LocalTime ours = read.at(instant);
        if (ours.offset != local.tm_gmtoff || ours.daylight != (local.tm_isdst > 0))
            return name + " at " + std::to_string(instant) + "\n";
    }
    return {};
}

TEST(ZoneFile, AgreesWithTheLibraryOnEveryInstalledZone) {
    const std::vector<std::string> zones = installedZones();
    EXPECT_GT(zones.size(), 300U);
    EXPECT_EQ(support::inChild([&zones] {
                  std::string differences;
                  for (const std::string& name : zones) differences += firstDifference(name);
                  return differences;
              }),
              "");
}

TEST(ZoneFile, IsRefusedUnlessWhole) {
    const std::string whole = zoneBytes("Europe/Berlin");
    ASSERT_TRUE(parseZoneFile(whole).has_value());
    for (std::size_t length = 0; length < whole.size(); ++length)
        ASSERT_FALSE(parseZoneFile(whole.substr(0, length)).has_value()) << length;
    EXPECT_FALSE(parseZoneFile("PK" + whole.substr(2)).has_value());
    std::string counts = whole;
    counts[36] = '\x7F'; // of local times
    EXPECT_FALSE(parseZoneFile(counts).has_value());
}

TEST(ZoneFile, OfTheFirstVersionHasOneBlock) {
    // One transition at 1000 from UTC to one hour east with daylight saving.
    std::string bytes = "TZif\0"s + std::string(15, '\0') + "\0\0\0\0"s + "\0\0\0\0"s + "\0\0\0\0"s + "\0\0\0\1"s +
                        "\0\0\0\2"s + "\0\0\0\4"s + "\0\0\x03\xE8"s + "\1"s + "\0\0\0\0\0\0"s + "\0\0\x0E\x10\1\0"s +
                        "UTC\0"s;
    const TimeZone read = parseZoneFile(bytes).value();
    EXPECT_EQ(read.at(999).offset, 0);
    EXPECT_EQ(read.at(1000).offset, 3600);
    EXPECT_TRUE(read.hasDaylightSavingFrom(0));
    bytes[44 + 4] = 2; // a local time that is not there
    EXPECT_FALSE(parseZoneFile(bytes).has_value());
}

TEST(ZoneFile, OfOurOwnIsWhatItsOffsetSays) {
    for (int minutes = -14 * 60; minutes <= 14 * 60; ++minutes) {
        const TimeZone read = parseZoneFile(makeZoneFile(minutes)).value();
        ASSERT_EQ(read.at(winter2026).offset, minutes * 60);
        ASSERT_EQ(read.at(summer2026).offset, minutes * 60);
        ASSERT_FALSE(read.hasDaylightSavingFrom(0));
    }
    const std::string bytes = makeZoneFile(330);
    EXPECT_EQ(bytes.substr(bytes.size() - 14), "\n<+0530>-5:30\n");
    EXPECT_NE(makeZoneFile(-345).find("\n<-0545>5:45\n"), std::string::npos);
    EXPECT_NE(makeZoneFile(60).find("\n<+01>-1\n"), std::string::npos);
    EXPECT_NE(makeZoneFile(0).find("\n<+00>0\n"), std::string::npos);
}

} // namespace

} // namespace VK::Zone
