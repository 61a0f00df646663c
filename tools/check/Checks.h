#pragma once

#include "vk/Root.h"

#include <string>
#include <vector>

namespace check {

/// One thing outside the provider that its classes need.
struct Finding {
    std::string name;
    bool found;
    std::string detail;  ///< where it is, or why it is not there
    std::string without; ///< what does not work without it
};

/// Looks for everything below the root.
std::vector<Finding> findings(const VK::Root& root);

} // namespace check
