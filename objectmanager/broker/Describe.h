#pragma once

#include "objectmanager/model/Values.h"

#include <string>

/// Texts for people who look for faults; no program should read them.
namespace om {

std::string describe(const Value& value);
/// `namespace:Class.Key="text",Other=1`
std::string describe(const ObjectPath& path);
std::string describe(const Instance& instance);
std::string describe(const std::vector<NamedValue>& list);

} // namespace om
