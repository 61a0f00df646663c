#pragma once

#include <string>
#include <string_view>

namespace endpoint {

/// Writes a line on standard error, where the service manager's journal reads it. Control characters are escaped and
/// long lines cut, so that what a client sends cannot look like a line of its own. A line that cannot be written is
/// lost.
void log(std::string_view line);

/// A text from a client for such a line: in quotes where it holds blanks, its own quotes escaped, cut where it is long,
/// `-` for none.
std::string logged(std::string_view text);

/// What a line ends with, and a client may have a part in: cut where it is long.
std::string detailed(std::string_view text);

} // namespace endpoint
