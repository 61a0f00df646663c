#pragma once

#include "objectmanager/model/Values.h"

#include <optional>
#include <string_view>

namespace mof {

/// A number as MOF writes it: uint64, sint64 where it is negative, real64 where it has a fraction or fits into neither.
om::Value readLiteral(std::string_view text);

/// A literal as a value of a type; nothing where it is none.
std::optional<om::Value> typed(const om::Value& literal, CMPIType type);

} // namespace mof
