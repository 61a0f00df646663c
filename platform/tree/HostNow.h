#pragma once

#include "common/FromFiles.h"
#include "host/State.h"
#include "vk/Root.h"
#include "zone/ZoneFile.h"

#include <atomic>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace VK::Tree {

/// A yes or no that is read at most once a second. Any number of threads may ask; none waits for another.
class YesOfThisSecond {
public:
    template <class Read>
    bool get(Read read);

private:
    std::atomic<std::uint64_t> known{0}; ///< twice the coarse milliseconds of when it was read, and 1 for yes; or 0
};

/// What of this host, or of a snapshot of one, may change at any time. Of a snapshot each change shows at once, and its
/// files are read anew only when they have changed. Of this host the name and the zone are as they are now; power state
/// and memory errors, whose files change without a trace, may be one second old. What was known stays where descriptors
/// run out.
class HostNow {
public:
    explicit HostNow(const Root& hostRoot) : root(hostRoot) {}

    std::optional<std::string> name();
    bool isShuttingDown();
    bool hasUncorrectableMemoryErrors();
    /// Never null.
    std::shared_ptr<const Zone::TimeZone> zone();

    /// To be called after a change of our own.
    void forget() { zoneInForce.forget(); }

private:
    const Root& root;
    FromFiles<std::optional<std::string>> snapshotName;
    FromFiles<Host::Shutdown> snapshotShutdown;
    FromFiles<bool> snapshotErrors;
    YesOfThisSecond shutdown;
    YesOfThisSecond memoryErrors;
    FromFiles<Zone::TimeZone> zoneInForce;
};

} // namespace VK::Tree
