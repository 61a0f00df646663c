#pragma once

#include "common/SeenFiles.h"
#include "vk/Root.h"
#include "zone/ZoneFile.h"

#include <optional>
#include <string>

namespace VK::Zone {

inline const std::string localTimeFile = "/etc/localtime";
inline const std::string zoneDirectory = "/usr/share/zoneinfo/";

/// The zone that a link like `../usr/share/zoneinfo/Europe/Berlin` names; empty for any other text.
std::string zoneNameOf(const std::string& link);

// The zone may change at any time; each of these looks anew.

/// The zone of a zone file, links followed. Nothing when it is missing, broken, no zone file, or neither
/// /etc/localtime itself nor one of the zone directory.
std::optional<TimeZone> zoneOfFile(const Root& root, const std::string& path);

/// The zone that /etc/localtime puts into force. UTC when it is missing, broken, no zone file, or neither a file
/// there nor one of the zone directory.
TimeZone zoneInForce(const Root& root);

/// The zone's offset now, in minutes east of UTC, and whether it has daylight saving now or later.
int offsetInForce(const Root& root);
bool hasDaylightSaving(const Root& root);

/// Adds the files that make the zone in force.
void addZoneFiles(const Root& root, SeenFiles& files);

/// The same of a zone that was read before; and the present time in it, as a CIM date-time with microseconds.
int offsetInForce(const TimeZone& zone);
bool hasDaylightSaving(const TimeZone& zone);
std::string systemTime(const TimeZone& zone);

} // namespace VK::Zone
