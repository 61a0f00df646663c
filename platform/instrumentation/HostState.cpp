#include "instrumentation/HostState.h"

#include "instrumentation/CimDateTime.h"
#include "instrumentation/TextFiles.h"

#include <array>
#include <ctime>
#include <unistd.h>

namespace VK {
namespace Inside {

namespace {

const std::string LOCAL_TIME = "/etc/localtime";
const std::string ZONE_FOLDER = "/usr/share/zoneinfo";

/// The most that a host name may take; longer ones are cut here, and so is one that has no end.
constexpr std::size_t LONGEST_NAME = 128;

std::optional<std::string> unlessEmpty(std::string text) {
    return text.empty() ? std::nullopt : std::optional<std::string>(std::move(text));
}

std::uint64_t microsecondsNow() {
    timespec time{};
    clock_gettime(CLOCK_REALTIME, &time);
    return static_cast<std::uint64_t>(time.tv_sec) * 1'000'000 + static_cast<std::uint64_t>(time.tv_nsec) / 1000;
}

/// Whether the path that /etc/localtime leads to is that file itself or one of the zone folder.
bool isTrusted(const Root& root, const std::string& path) {
    const Root::Contents folder = root.resolve(ZONE_FOLDER);
    if (folder && path.rfind(folder.text + "/", 0) == 0) return true;
    const Root::Contents parent = root.resolve("/etc");
    return parent && path == parent.text + "/localtime";
}

} // namespace

std::optional<std::string> hostName(const Root& root) {
    if (!root.isLive()) return unlessEmpty(hostNameFromFile(root.read("/etc/hostname").text));
    std::array<char, LONGEST_NAME + 1> name{}; // the last byte stays zero, whatever is written before it
    if (gethostname(name.data(), LONGEST_NAME) != 0) return std::nullopt;
    return unlessEmpty(name.data());
}

unsigned int powerState(const Root& root) {
    constexpr unsigned int ON = 1;
    constexpr unsigned int SHUTTING_DOWN = 16;
    const bool shutdown = utmpSaysShutdown(root.read("/run/utmp").text) ||
                          scheduledShutdownIsDue(root.read("/run/systemd/shutdown/scheduled").text, microsecondsNow());
    return shutdown ? SHUTTING_DOWN : ON;
}

bool hasUncorrectableMemoryErrors(const Root& root) {
    const std::string folder = "/sys/devices/system/edac/mc/";
    for (const std::string& name : root.list(folder).names) {
        if (name.rfind("mc", 0) != 0) continue;
        std::string file = folder;
        file.append(name).append("/ue_count");
        if (root.read(file).text.find_first_of("123456789") != std::string::npos) return true;
    }
    return false;
}

std::optional<Zone> zoneOfFile(const Root& root, const std::string& path) {
    const Root::Contents real = root.resolve(path);
    if (!real || !isTrusted(root, real.text)) return std::nullopt;
    return parseZoneFile(root.read(real.text).text);
}

Zone zoneInForce(const Root& root) {
    return zoneOfFile(root, LOCAL_TIME).value_or(Zone());
}

int offsetInForce(const Root& root) {
    return zoneInForce(root).at(std::time(nullptr)).offset / 60;
}

bool hasDaylightSaving(const Root& root) {
    return zoneInForce(root).hasDaylightSavingFrom(std::time(nullptr));
}

std::string systemTime(const Root& root) {
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    return formatCimDateTime({now.tv_sec, now.tv_nsec / 1000}, zoneInForce(root).at(now.tv_sec).offset / 60);
}

} // namespace Inside
} // namespace VK
