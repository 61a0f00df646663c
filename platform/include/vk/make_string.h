#pragma once

#include <string>

namespace VK {

/// Narrows a wide text to UTF-8. A wide character that is no Unicode scalar value becomes U+FFFD.
std::string make_string(const std::wstring& text);

} // namespace VK
