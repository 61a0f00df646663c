#pragma once

#include "common/CimDateTime.h"
#include "vk/Root.h"

#include <ctime>
#include <string>
#include <string_view>

namespace VK::Zone {

/// Sets this host's clock to a CIM date-time, and then the hardware clock where there is one. True when the clock
/// was set; else false, with one log line that says why: no date-time, one before 2000, the root is not this
/// host's, or the privilege CAP_SYS_TIME is missing. A change writes one line too: from when, to when, by whom.
bool changeClock(const Root& root, const std::string& text);

/// Why a text is not what a clock may be set to; empty, with `instant` filled in, when it is.
std::string checkClockText(const std::string& text, Instant& instant);

/// What a hardware clock is set to at an instant: UTC, or local time where it keeps that. To the nearest second.
tm hardwareClockTime(Instant instant, int offsetSeconds);

/// Whether the hardware clock keeps local time, as the third line of /etc/adjtime says.
bool adjtimeSaysLocal(std::string_view text);

} // namespace VK::Zone
