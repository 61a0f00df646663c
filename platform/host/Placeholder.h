#pragma once

#include <string_view>

namespace VK::Host {

/// Whether a text of the firmware tells nothing: what a manufacturer left as it came ("To Be Filled By O.E.M."),
/// the name of the field itself, fillers. Case, blanks at the ends and how many blanks stand between words do not
/// matter.
bool isPlaceholder(std::string_view text);

/// The same for a serial number, which can moreover be one that only counts (0123456789).
bool isPlaceholderSerial(std::string_view text);

} // namespace VK::Host
