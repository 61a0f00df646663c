#pragma once

#include "objectmanager/model/Names.h"

/// Letters as CIM sees them, whatever the locale.
namespace vkcim {

inline bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

/// Names may hold any letter beyond ASCII.
inline bool isNameStart(char c) {
    return (om::lower(c) >= 'a' && om::lower(c) <= 'z') || c == '_' || static_cast<unsigned char>(c) >= 0x80;
}

inline bool isNameByte(char c) {
    return isNameStart(c) || isDigit(c);
}

} // namespace vkcim
