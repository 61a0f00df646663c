#pragma once

#include "vk/Root.h"

#include <string>

namespace VK {

/// The machine as its kernel names it; of a snapshot what its own kernel said, where that is there to be read, else
/// this kernel's name.
std::string architectureOf(const Root& root);

} // namespace VK
