#pragma once

namespace NVLog {

/// Sends a text to syslog: through the C library or, in the child of a fork that may have lost the C library's lock,
/// straight to /dev/log.
void sendToSyslog(int priority, const char* text) noexcept;

} // namespace NVLog
