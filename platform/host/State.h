#pragma once

#include "vk/Root.h"

#include <optional>
#include <string>
#include <vector>

namespace VK::Host {

// What of a host may change at any time; each of these looks anew.

/// The kernel's node name; below another root what /etc/hostname says. Nothing when there is none.
std::optional<std::string> hostName(const Root& root);

/// What the host's files say of its end.
struct Shutdown {
    bool runLevel = false; ///< the run level is that of a host that goes down
    std::string scheduled; ///< the bytes of the file that announces a shutdown

    /// Whether the host shuts down now.
    bool isUnderWay() const;
};

Shutdown readShutdown(const Root& root);

/// Whether any memory controller has counted an error that could not be corrected.
bool hasUncorrectableMemoryErrors(const Root& root);

// The files that these are made of.

inline const std::string hostNameFile = "/etc/hostname";
inline const std::string runLevelFile = "/run/utmp";
inline const std::string scheduledShutdownFile = "/run/systemd/shutdown/scheduled";
inline const std::string memoryControllers = "/sys/devices/system/edac/mc";

/// One for each memory controller.
std::vector<std::string> memoryErrorFiles(const Root& root);

} // namespace VK::Host
