#pragma once

#include "objectmanager/model/Values.h"

#include <optional>
#include <string>
#include <string_view>

/// Numbers as texts and back, exactly.
namespace om {

/// The decimal text of an integer value or char16 with all its digits, or of a real: the shortest that reads back the
/// same in its width, `NaN`, `Infinity` or `-Infinity`. Empty for values that are no numbers.
std::string numberText(const Value& value);

enum class NumberError { None, NotANumber, OutOfRange };

/// Reads `text` as a value of an integer type, char16 or a real type.
NumberError readNumber(std::string_view text, CMPIType type, Value& value);

/// The values that a type can hold, for messages: `0 to 255`.
std::string rangeOf(CMPIType type);

/// Whether `text` consists of digits alone, perhaps after a minus.
bool looksLikeInteger(std::string_view text);
/// Whether `text` is a number with a point or an exponent.
bool looksLikeReal(std::string_view text);

} // namespace om
