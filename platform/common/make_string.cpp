#include "vk/make_string.h"

namespace VK {

namespace {

void appendUtf8(std::string& text, char32_t c) {
    const auto put = [&text](char32_t byte) { text += static_cast<char>(static_cast<unsigned char>(byte)); };
    const auto putRest = [&](unsigned int shift) { put(0x80 | (c >> shift & 0x3F)); };
    if (c < 0x80) {
        put(c);
    } else if (c < 0x800) {
        put(0xC0 | c >> 6);
        putRest(0);
    } else if (c < 0x10000) {
        put(0xE0 | c >> 12);
        putRest(6);
        putRest(0);
    } else {
        put(0xF0 | c >> 18);
        putRest(12);
        putRest(6);
        putRest(0);
    }
}

bool isScalarValue(char32_t c) {
    return c <= 0x10FFFF && !(c >= 0xD800 && c <= 0xDFFF);
}

} // namespace

std::string make_string(const std::wstring& text) {
    constexpr char32_t REPLACEMENT = 0xFFFD;
    std::string narrow;
    narrow.reserve(text.size());
    for (const wchar_t wide : text) {
        const auto c = static_cast<char32_t>(wide);
        appendUtf8(narrow, isScalarValue(c) ? c : REPLACEMENT);
    }
    return narrow;
}

} // namespace VK
