#pragma once

#include <string>

namespace VK {
#pragma GCC visibility push(hidden)
namespace Inside {

constexpr int NOTICE = 3000; ///< something of the host was changed, or is kept from us
constexpr int DETAIL = 4000; ///< the host lacks something that hosts may lack
constexpr int FAILURE = 6000;

/// Writes one line under the library's category. Never throws, whatever logger stands behind it.
void logLine(int level, const char* function, int line, const std::string& text) noexcept;

/// What an errno value means, for log lines.
std::string errorText(int error);

/// A text from outside as part of a log line: printable, in quotes, cut after 64 bytes.
std::string inQuotes(const std::string& text);

} // namespace Inside
#pragma GCC visibility pop
} // namespace VK
