#pragma once

#include "vk/Root.h"

#include <optional>
#include <string>

namespace VK::Host {

// What of a host may change at any time; each of these looks anew.

/// The kernel's node name; below another root what /etc/hostname says. Nothing when there is none.
std::optional<std::string> hostName(const Root& root);

/// 1 on, 16 shutting down.
unsigned int powerState(const Root& root);

/// Whether any memory controller has counted an error that could not be corrected.
bool hasUncorrectableMemoryErrors(const Root& root);

} // namespace VK::Host
