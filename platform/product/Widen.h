#pragma once

#include <string>
#include <string_view>

namespace VK {

/// Widens UTF-8. A byte that belongs to no well-formed character becomes U+FFFD.
std::wstring widen(std::string_view text);

} // namespace VK
