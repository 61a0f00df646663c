#pragma once

#include <string>
#include <string_view>

namespace vkcim {

/// The text with everything that is not UTF-8 replaced by U+FFFD, one for each maximal part of a character.
std::string cleanUtf8(std::string_view text);

/// cleanUtf8, with control characters written `\n`, `\t`, `\r` or `\xNN`, so that a text stays on its line and cannot
/// steer a terminal.
std::string printable(std::string_view text);

/// printable, for messages: of a text that is longer than a few lines only its beginning and its end.
std::string shortened(std::string_view text);

} // namespace vkcim
