#include "zone/ZoneChange.h"

#include "logger/LogLine.h"
#include "zone/ZoneFiles.h"
#include "zone/ZoneInForce.h"

#include <cstdlib>
#include <ctime>
#include <unistd.h>

namespace VK::Zone {

namespace {

constexpr int farthest = 14 * 60;

bool refuse(const std::string& reason) {
    logLine(failure, "setProperty", __LINE__, reason);
    return false;
}

std::string offsetText(int minutes) {
    const std::string digits = std::to_string(std::abs(minutes));
    return (minutes < 0 ? "-" : "+") + std::string(digits.size() < 3 ? 3 - digits.size() : 0, '0') + digits;
}

bool refuse(const std::string& what, const ZoneFiles& files) {
    return refuse(what + ": " + files.problem());
}

/// Ends a change: the process's own idea of local time, and the log line.
bool finish(const Root& root, const std::string& what, const ZoneFiles& files) {
    if (!files.changed()) return true;
    if (root.isLive()) tzset();
    logLine(notice, "setProperty", __LINE__,
            what + " (" + files.before().name + " became " + files.after().name + ") by uid " +
                std::to_string(getuid()));
    return true;
}

} // namespace

bool changeOffset(const Root& root, int minutes) {
    if (minutes < -farthest || minutes > farthest)
        return refuse("offset from UTC of " + std::to_string(minutes) + " minutes is not between -840 and +840");
    if (minutes == offsetInForce(root)) return true;
    ZoneFiles files(root);
    if (!files.putOffset(minutes)) return refuse("offset from UTC not set to " + offsetText(minutes), files);
    return finish(
        root, "offset from UTC from " + offsetText(files.before().offset) + " to " + offsetText(files.after().offset),
        files);
}

bool changeDaylightSaving(const Root& root, bool on) {
    if (hasDaylightSaving(root) == on) return true;
    ZoneFiles files(root);
    if (!(on ? files.bringBack() : files.dropDaylightSaving()))
        return refuse(std::string("automatic daylight saving not set to ") + (on ? "1" : "0"), files);
    const char* what = "automatic daylight saving from 1 to 0";
    if (on && files.after().daylightSaving)
        what = "automatic daylight saving from 0 to 1";
    else if (on)
        what = "the zone replaced before is back, without daylight saving";
    return finish(root, what, files);
}

} // namespace VK::Zone
