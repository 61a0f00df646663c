#pragma once

#include <string>
#include <string_view>

namespace endpoint {

/// Writes a line on standard error, where the service manager's journal reads it. Control characters are escaped, so
/// that what a client sends cannot look like a line of its own. A line that cannot be written is lost.
void log(std::string_view line);

/// A text from a client for such a line: in quotes where it holds blanks, cut where it is long, `-` for none.
std::string logged(std::string_view text);

} // namespace endpoint
