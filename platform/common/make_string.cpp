#include "vk/make_string.h"

#include <utf8.h>

#include <iterator>

namespace VK {

namespace {

constexpr char32_t replacement = 0xFFFD;

bool isScalarValue(char32_t c) {
    return c <= 0x10FFFF && !(c >= 0xD800 && c <= 0xDFFF);
}

} // namespace

std::string make_string(const std::wstring& text) {
    std::string narrow;
    narrow.reserve(text.size());
    for (const wchar_t wide : text) {
        const auto c = static_cast<char32_t>(wide);
        utf8::unchecked::append(isScalarValue(c) ? c : replacement, std::back_inserter(narrow));
    }
    return narrow;
}

} // namespace VK
