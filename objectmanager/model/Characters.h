#pragma once

#include "objectmanager/model/Names.h"

/// Letters as CIM sees them, and blanks, whatever the locale.
namespace om {

constexpr bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

/// Names may hold any letter beyond ASCII.
constexpr bool isNameStart(char c) {
    return (lower(c) >= 'a' && lower(c) <= 'z') || c == '_' || static_cast<unsigned char>(c) >= 0x80;
}

constexpr bool isNameByte(char c) {
    return isNameStart(c) || isDigit(c);
}

/// The text without the blanks at its ends.
constexpr std::string_view trimmed(std::string_view text, std::string_view blanks = " \t\r\n") {
    const std::size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

} // namespace om
