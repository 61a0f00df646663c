#include "zone/ZoneInForce.h"

#include "common/CimDateTime.h"

#include <ctime>

namespace VK::Zone {

namespace {

/// Whether the path that /etc/localtime leads to is that file itself or one of the zone directory.
bool isTrusted(const Root& root, const std::string& path) {
    const Root::Contents directory = root.resolve(zoneDirectory);
    if (directory && path.rfind(directory.text + "/", 0) == 0) return true;
    const Root::Contents parent = root.resolve("/etc");
    return parent && path == parent.text + "/localtime";
}

} // namespace

std::string zoneNameOf(const std::string& link) {
    const std::string directory = "zoneinfo/";
    const std::size_t found = link.rfind(directory);
    return found == std::string::npos ? std::string() : link.substr(found + directory.size());
}

std::optional<TimeZone> zoneOfFile(const Root& root, const std::string& path) {
    const Root::Contents real = root.resolve(path);
    if (!real || !isTrusted(root, real.text)) return std::nullopt;
    return parseZoneFile(root.read(real.text).text);
}

TimeZone zoneInForce(const Root& root) {
    return zoneOfFile(root, localTimeFile).value_or(TimeZone());
}

void addZoneFiles(const Root& root, SeenFiles& files) {
    files.add(localTimeFile);
    files.addLinks(zoneDirectory); // both decide whether the file is trusted
    files.addLinks("/etc");
    // A file that is not trusted becomes so where its directory's name takes the zone directory's place.
    if (const Root::Contents real = root.resolve(localTimeFile); real && !isTrusted(root, real.text))
        files.add(zoneDirectory);
}

int offsetInForce(const TimeZone& zone) {
    return zone.at(std::time(nullptr)).offset / 60;
}

bool hasDaylightSaving(const TimeZone& zone) {
    return zone.hasDaylightSavingFrom(std::time(nullptr));
}

int offsetInForce(const Root& root) {
    return offsetInForce(zoneInForce(root));
}

bool hasDaylightSaving(const Root& root) {
    return hasDaylightSaving(zoneInForce(root));
}

std::string systemTime(const TimeZone& zone) {
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    return formatCimDateTime({now.tv_sec, now.tv_nsec / 1000}, zone.at(now.tv_sec).offset / 60);
}

} // namespace VK::Zone
