#pragma once

#include "vk/Root.h"

namespace VK::Zone {

// Each returns true when the host is as asked, changed or not; else false, with one log line that says why, and nothing
// is changed or forgotten. A change writes one line too: from what, to what, by which user. Whatever interrupts a
// change, /etc/localtime is a valid zone, and the zone before it is in force or remembered.

/// Puts a zone without daylight saving into force, that many minutes east of UTC (-840 to 840). The zone that it
/// replaces is kept for `changeDaylightSaving`, unless one is kept already.
bool changeOffset(const Root& root, int minutes);

/// Off: puts a zone without daylight saving into force, at the standard offset of the one in force, and keeps that.
/// On: brings back exactly what was kept, if that is a zone; also one without daylight saving.
bool changeDaylightSaving(const Root& root, bool on);

} // namespace VK::Zone
