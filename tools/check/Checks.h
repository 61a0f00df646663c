#pragma once

#include "vk/Root.h"

#include <string>
#include <vector>

namespace check {

/// What the provider needs a thing for: to say what the host is, or to change it.
enum class Part { Reading, Setting };

/// One thing outside the provider that its classes need.
struct Finding {
    Part part;
    std::string name;
    bool found;
    std::string detail;  ///< where it is, or why it is not there
    std::string without; ///< what does not work without it
};

/// Looks for everything below the root.
std::vector<Finding> findings(const VK::Root& root);

} // namespace check
