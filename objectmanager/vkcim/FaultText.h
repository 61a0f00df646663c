#pragma once

#include "objectmanager/broker/Fault.h"

#include <string>

namespace vkcim {

/// Reads `KIND:N`, `KIND:N+` (the N-th call and all after it) or either with `:null` behind it (the status then says
/// OK). Throws std::runtime_error that says what is wrong.
om::Fault parseFault(const std::string& text);

/// The names that KIND can be, one a line.
std::string faultList();

} // namespace vkcim
