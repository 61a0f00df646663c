#pragma once

#include "host/HardwareFacts.h"
#include "tree/NodeTree.h"

#include <optional>
#include <vector>

namespace VK::Tree {

/// The nodes of a host, with the properties that never change: the computer system, then each chassis.
std::vector<Node> hostNodes(const Host::HardwareFacts& facts);

/// What one of the computer system's properties that may change holds now; nothing also for all others.
std::optional<Value> changingProperty(const Root& root, unsigned int property);

} // namespace VK::Tree
