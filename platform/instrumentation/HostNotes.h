#pragma once

#include "instrumentation/HardwareFacts.h"

#include <string>
#include <vector>

namespace VK {
namespace Inside __attribute__((visibility("hidden"))) {

    /// One line for each thing that the facts lack, and why.
    std::vector<std::string> notesOn(const HardwareFacts& facts);

} // namespace )
} // namespace VK
