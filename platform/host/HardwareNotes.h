#pragma once

#include "host/HardwareFacts.h"

#include <string>
#include <vector>

namespace VK::Host {

/// One line for each thing that the facts lack, and why.
std::vector<std::string> notesOn(const HardwareFacts& facts);

} // namespace VK::Host
