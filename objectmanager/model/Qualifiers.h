#pragma once

#include "objectmanager/model/Values.h"

#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

namespace om {

/// What a declaration carries in its brackets, as the MOF files write it and in their order: each value is a boolean, a
/// string or an array of strings. Names compare without regard to case.
using Qualifiers = std::vector<NamedValue>;

/// A qualifier's value, for tables of declarations.
Value qualifierValue(bool value);
Value qualifierValue(const char* text);
Value qualifierValue(std::initializer_list<const char*> texts);
Value qualifierValue(int) = delete; // would become a boolean

/// Whether a qualifier is there and true.
bool isMarked(const Qualifiers& qualifiers, std::string_view name);

/// A qualifier's string; empty where it is missing.
std::string_view textOf(const Qualifiers& qualifiers, std::string_view name);

/// A qualifier's strings; empty where it is missing.
std::vector<std::string_view> textsOf(const Qualifiers& qualifiers, std::string_view name);

/// The words that ValueMap and Values have for a whole number, or for each element of an array of these: one for each,
/// empty for a number without a word. No words at all for any other value, and where no number has one.
std::vector<std::string_view> wordsFor(const Qualifiers& qualifiers, const Value& value);

} // namespace om
