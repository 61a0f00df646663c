#pragma once

#include "instrumentation/HardwareFacts.h"
#include "instrumentation/NodeTree.h"

#include <optional>
#include <vector>

namespace VK {
#pragma GCC visibility push(hidden)
namespace Inside {

/// The nodes of a host, with the properties that never change: the computer system, then each chassis.
std::vector<Node> hostNodes(const HardwareFacts& facts);

/// What one of the computer system's properties that may change holds now; nothing also for all others.
std::optional<Value> changingProperty(const Root& root, unsigned int property);

} // namespace Inside
#pragma GCC visibility pop
} // namespace VK
