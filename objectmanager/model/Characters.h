#pragma once

#include "objectmanager/model/Names.h"

/// Letters as CIM sees them, whatever the locale.
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

} // namespace om
