#include "host/State.h"

#include "host/TextFiles.h"

#include <array>
#include <ctime>
#include <unistd.h>

namespace VK::Host {

namespace {

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
    bool found = false;
    const std::string folder = "/sys/devices/system/edac/mc/";
    for (const std::string& name : root.list(folder).names) {
        if (name.rfind("mc", 0) != 0) continue;
        std::string file = folder;
        file.append(name).append("/ue_count");
        found = root.read(file).text.find_first_of("123456789") != std::string::npos || found;
    }
    return found;
}

} // namespace VK::Host
