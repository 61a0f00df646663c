#pragma once

#include <cmpidt.h>

#include <optional>
#include <string>
#include <string_view>

/// The words for types and statuses.
namespace om {

/// The type that a word stands for (`uint16`, `datetime[]`, …), or nothing.
std::optional<CMPIType> typeNamed(std::string_view word);

/// The word for a type; `null` for CMPI_null, and the number in hexadecimal for a type that has no word.
std::string typeName(CMPIType type);

inline bool isArray(CMPIType type) {
    return (type & CMPI_ARRAY) != 0;
}

inline CMPIType elementType(CMPIType type) {
    return static_cast<CMPIType>(type & ~CMPI_ARRAY);
}

/// `CMPI_RC_OK` and so on; `UNKNOWN` for a code without a name.
const char* statusName(int code);

} // namespace om
