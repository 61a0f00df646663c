#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <string_view>

namespace VK::Host {

/// The values of a file of `KEY="value"` lines such as /etc/machine-info, comments left out; the last of several
/// lines counts. Quotes and backslashes as the shell reads them.
std::map<std::string, std::string> parseAssignments(std::string_view text);

/// The value of a line `Key:   value   ` of /proc/sysinfo; empty where there is none.
std::string sysinfoValue(std::string_view text, std::string_view key);

/// A text property of a device tree: what stands before the first NUL.
std::string deviceTreeText(std::string_view bytes);

/// The host name that /etc/hostname says: its first line that is neither empty nor a comment.
std::string hostNameFromFile(std::string_view text);

/// Whether /run/utmp says that the last change of run level led to 0 or 6.
bool utmpSaysShutdown(std::string_view bytes);

/// Whether a shutdown that /run/systemd/shutdown/scheduled announces is due; `now` in microseconds since 1970. A
/// dry run does not count.
bool scheduledShutdownIsDue(std::string_view text, std::uint64_t now);

} // namespace VK::Host
