#pragma once

#include "objectmanager/model/Values.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace om {

/// The lower-case form of an ASCII letter; any other character as it is. Independent of the locale.
constexpr char lower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

/// Whether two CIM names are the same: they compare without regard to case.
bool sameName(std::string_view a, std::string_view b);
/// Whether the list has the name.
bool containsName(const std::vector<std::string>& names, std::string_view name);

/// Hash and equality of CIM names, for hash tables that are searched without making a lower-case copy first.
struct NameHash {
    std::size_t operator()(std::string_view name) const;
};
struct NameEqual {
    bool operator()(std::string_view a, std::string_view b) const { return sameName(a, b); }
};

/// The value of that name, or null. Lists are short: a linear search beats a table.
const Value* findValue(const std::vector<NamedValue>& list, std::string_view name);
/// Adds a value, or replaces the one of the same name, whose spelling and position stay.
void putValue(std::vector<NamedValue>& list, std::string_view name, Value value);

} // namespace om
