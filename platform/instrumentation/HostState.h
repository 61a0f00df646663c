#pragma once

#include "instrumentation/ZoneFile.h"
#include "vk/Root.h"

#include <optional>
#include <string>

namespace VK {
#pragma GCC visibility push(hidden)
namespace Inside {

// What of a host may change at any time; each of these looks anew.

/// The kernel's node name; below another root what /etc/hostname says. Nothing when there is none.
std::optional<std::string> hostName(const Root& root);

/// 1 on, 16 shutting down.
unsigned int powerState(const Root& root);

/// Whether any memory controller has counted an error that could not be corrected.
bool hasUncorrectableMemoryErrors(const Root& root);

/// The zone of a zone file, links followed. Nothing when it is missing, broken, no zone file, or neither /etc/localtime
/// itself nor one of the zone directory.
std::optional<Zone> zoneOfFile(const Root& root, const std::string& path);

/// The zone that /etc/localtime puts into force. UTC when it is missing, broken, no zone file, or neither a file
/// there nor one of the zone folder.
Zone zoneInForce(const Root& root);

/// The zone's offset now, in minutes east of UTC, and whether it has daylight saving now or later.
int offsetInForce(const Root& root);
bool hasDaylightSaving(const Root& root);

/// Now, as a CIM date-time with microseconds and the offset in force.
std::string systemTime(const Root& root);

} // namespace Inside
#pragma GCC visibility pop
} // namespace VK
