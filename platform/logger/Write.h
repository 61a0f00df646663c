#pragma once

#include <string_view>

namespace NVLog {

/// Writes a line, which brings its line feed along, with one write. False when not all of it was taken: a full disk,
/// or a full pipe that was opened not to wait. A line cut short that way is ended before the next one is written. No
/// signal comes of a pipe without reader or of a file size limit.
bool writeLine(int descriptor, std::string_view line) noexcept;

} // namespace NVLog
