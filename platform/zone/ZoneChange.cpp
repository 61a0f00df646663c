#include "zone/ZoneChange.h"

#include "logger/LogLine.h"
#include "zone/ZoneFiles.h"
#include "zone/ZoneInForce.h"

#include <cstdlib>
#include <ctime>
#include <unistd.h>

namespace VK::Zone {

namespace {

constexpr int FARTHEST = 14 * 60;

bool refuse(const std::string& why) {
    logLine(FAILURE, "setProperty", __LINE__, why);
    return false;
}

std::string offsetText(int minutes) {
    const std::string digits = std::to_string(std::abs(minutes));
    return (minutes < 0 ? "-" : "+") + std::string(digits.size() < 3 ? 3 - digits.size() : 0, '0') + digits;
}

/// Ends a change: the log line, and the process's own idea of local time.
bool finish(const Root& root, bool done, const std::string& what, const ZoneFiles& files) {
    if (!done) return refuse(what + " not changed: " + files.problem());
    if (files.after().empty()) return true;
    if (root.isLive()) tzset();
    logLine(NOTICE, "setProperty", __LINE__,
            what + " (" + files.before() + " became " + files.after() + ") by uid " + std::to_string(getuid()));
    return true;
}

std::string fromTo(const std::string& what, const std::string& from, const std::string& to) {
    return what + " from " + from + " to " + to;
}

} // namespace

bool changeOffset(const Root& root, int minutes) {
    const int now = offsetInForce(root);
    if (minutes < -FARTHEST || minutes > FARTHEST)
        return refuse("offset from UTC of " + std::to_string(minutes) + " minutes is not between -840 and +840");
    if (minutes == now) return true;
    ZoneFiles files(root, [&] { return offsetInForce(root) == minutes; });
    const bool done = files.replaceByOffset(minutes, ZoneFiles::KeepFirst);
    return finish(root, done, fromTo("offset from UTC", offsetText(now), offsetText(minutes)), files);
}

bool changeDaylightSaving(const Root& root, bool on) {
    const std::time_t now = std::time(nullptr);
    const TimeZone zone = zoneInForce(root);
    if (zone.hasDaylightSavingFrom(now) == on) return true;
    ZoneFiles files(root, [&] { return hasDaylightSaving(root) == on; });
    const bool done =
        on ? files.bringBack() : files.replaceByOffset(zone.standardOffsetAt(now) / 60, ZoneFiles::KeepLatest);
    return finish(root, done, fromTo("automatic daylight saving", on ? "0" : "1", on ? "1" : "0"), files);
}

} // namespace VK::Zone
