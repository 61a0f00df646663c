#include "host/State.h"

#include "host/TextFiles.h"

#include <array>
#include <ctime>
#include <unistd.h>

namespace VK::Host {

namespace {

/// The most that a host name may take; longer ones are cut here, and so is one that has no end.
constexpr std::size_t longestName = 128;

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
    if (!root.isLive()) return unlessEmpty(hostNameFromFile(root.read(hostNameFile).text));
    std::array<char, longestName + 1> name{}; // the last byte stays zero, whatever is written before it
    if (gethostname(name.data(), longestName) != 0) return std::nullopt;
    return unlessEmpty(name.data());
}

Shutdown readShutdown(const Root& root) {
    return {utmpSaysShutdown(root.read(runLevelFile).text), root.read(scheduledShutdownFile).text};
}

bool Shutdown::isUnderWay() const {
    return runLevel || scheduledShutdownIsDue(scheduled, microsecondsNow());
}

std::vector<std::string> memoryErrorFiles(const Root& root) {
    std::vector<std::string> files;
    for (const std::string& name : root.list(memoryControllers).names)
        if (name.rfind("mc", 0) == 0) files.push_back(memoryControllers + "/" + name + "/ue_count");
    return files;
}

bool hasUncorrectableMemoryErrors(const Root& root) {
    bool found = false; // all are read: a root that keeps a record must note them
    for (const std::string& file : memoryErrorFiles(root))
        found = root.read(file).text.find_first_of("123456789") != std::string::npos || found;
    return found;
}

} // namespace VK::Host
