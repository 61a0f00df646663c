#include "tree/HostNow.h"

#include "vk/Kept.h"
#include "zone/ZoneInForce.h"

#include <ctime>

namespace VK::Tree {

namespace {

/// Milliseconds since the host started, as coarse as the kernel's tick: no system call.
std::uint64_t coarseNow() {
    timespec time{};
    clock_gettime(CLOCK_MONOTONIC_COARSE, &time);
    return static_cast<std::uint64_t>(time.tv_sec) * 1000 + static_cast<std::uint64_t>(time.tv_nsec) / 1'000'000;
}

} // namespace

template <class Read>
bool YesOfThisSecond::get(Read read) {
    constexpr std::uint64_t second = 1000;
    const std::uint64_t now = coarseNow();
    const std::uint64_t before = known;
    if (before != 0 && now - before / 2 < second) return before % 2 != 0;
    const ShortageWatch shortage;
    const bool yes = read();
    if (shortage.seen()) return before != 0 ? before % 2 != 0 : yes;
    known = now * 2 + (yes ? 1 : 0);
    return yes;
}

std::optional<std::string> HostNow::name() {
    if (root.isLive()) return Host::hostName(root);
    return *snapshotName.get(root, [this](SeenFiles& files) {
        files.add(Host::hostNameFile);
        return Host::hostName(root);
    });
}

bool HostNow::isShuttingDown() {
    if (root.isLive()) return shutdown.get([this] { return Host::readShutdown(root).isUnderWay(); });
    const auto read = [this](SeenFiles& files) {
        files.add(Host::runLevelFile);
        files.add(Host::scheduledShutdownFile);
        return Host::readShutdown(root);
    };
    return snapshotShutdown.get(root, read)->isUnderWay(); // the time passes without a change of the file
}

bool HostNow::hasUncorrectableMemoryErrors() {
    if (root.isLive()) return memoryErrors.get([this] { return Host::hasUncorrectableMemoryErrors(root); });
    return *snapshotErrors.get(root, [this](SeenFiles& files) {
        files.add(Host::memoryControllers);
        for (const std::string& file : Host::memoryErrorFiles(root)) files.add(file);
        return Host::hasUncorrectableMemoryErrors(root);
    });
}

std::shared_ptr<const Zone::TimeZone> HostNow::zone() {
    return zoneInForce.get(root, [this](SeenFiles& files) {
        Zone::addZoneFiles(root, files);
        return Zone::zoneInForce(root);
    });
}

} // namespace VK::Tree
