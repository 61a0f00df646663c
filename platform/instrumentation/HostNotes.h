#pragma once

#include "instrumentation/HardwareFacts.h"

#include <string>
#include <vector>

namespace VK {
#pragma GCC visibility push(hidden)
namespace Inside {

/// One line for each thing that the facts lack, and why.
std::vector<std::string> notesOn(const HardwareFacts& facts);

} // namespace Inside
#pragma GCC visibility pop
} // namespace VK
