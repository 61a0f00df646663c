#include "product/Widen.h"

namespace VK {

namespace {

constexpr char32_t REPLACEMENT = 0xFFFD;

/// What a character's first byte says: how many bytes follow, the bits it holds itself, and the smallest character that
/// needs so many.
struct Lead {
    std::size_t following;
    char32_t bits;
    char32_t smallest;
};

Lead readLead(unsigned char byte) {
    if (byte < 0x80) return {0, byte, 0};
    if (byte >= 0xC0 && byte < 0xE0) return {1, byte & 0x1FU, 0x80};
    if (byte >= 0xE0 && byte < 0xF0) return {2, byte & 0x0FU, 0x800};
    if (byte >= 0xF0 && byte < 0xF8) return {3, byte & 0x07U, 0x10000};
    return {0, REPLACEMENT, 0};
}

/// Takes one character off the text's front.
char32_t takeCharacter(std::string_view& text) {
    const Lead lead = readLead(static_cast<unsigned char>(text.front()));
    text.remove_prefix(1);
    if (lead.following > text.size()) return REPLACEMENT;
    char32_t c = lead.bits;
    for (std::size_t i = 0; i < lead.following; ++i) {
        const auto byte = static_cast<unsigned char>(text[i]);
        if ((byte & 0xC0) != 0x80) return REPLACEMENT;
        c = c << 6 | (byte & 0x3FU);
    }
    if (c < lead.smallest || c > 0x10FFFF || (c >= 0xD800 && c <= 0xDFFF)) return REPLACEMENT;
    text.remove_prefix(lead.following);
    return c;
}

} // namespace

std::wstring widen(std::string_view text) {
    std::wstring wide;
    wide.reserve(text.size());
    while (!text.empty()) wide += static_cast<wchar_t>(takeCharacter(text));
    return wide;
}

} // namespace VK
