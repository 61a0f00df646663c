#pragma once

#include <string_view>

namespace NVLog {

/// Appends a line to the file at `path`, made with mode 0640 where it is missing, and opened again when another
/// file has taken its place. False when it cannot be opened or written. The descriptor stays open between lines.
bool appendToFile(const char* path, std::string_view line) noexcept;

} // namespace NVLog
