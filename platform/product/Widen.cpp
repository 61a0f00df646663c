#include "product/Widen.h"

#include <utf8.h>

namespace VK {

namespace {

constexpr char32_t replacement = 0xFFFD;

char32_t takeCharacter(std::string_view& text) {
    const char* position = text.data();
    try {
        const char32_t character = utf8::next(position, text.data() + text.size());
        text.remove_prefix(static_cast<std::size_t>(position - text.data()));
        return character;
    } catch (const utf8::exception&) {
        text.remove_prefix(1);
        return replacement;
    }
}

} // namespace

std::wstring widen(std::string_view text) {
    std::wstring wide;
    wide.reserve(text.size());
    while (!text.empty()) wide += static_cast<wchar_t>(takeCharacter(text));
    return wide;
}

} // namespace VK
