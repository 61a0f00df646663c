#pragma once

#include "host/HardwareFacts.h"
#include "tree/HostNow.h"
#include "tree/NodeTree.h"
#include "vk/NodeLexicon.h"
#include "vk/Root.h"

#include <optional>
#include <vector>

namespace VK::Tree {

/// The nodes of a host, with the properties that never change: the computer system, then each chassis.
std::vector<Node> hostNodes(const Host::HardwareFacts& facts);

/// A property that may change at any time.
struct ChangingProperty {
    NodeLexicon::Properties number;
    std::optional<Value> (*read)(HostNow& host);
    /// Changes it and returns the change's result; nothing for a value that it cannot take. Null: read-only.
    std::optional<bool> (*change)(const Root& root, const Value& value) = nullptr;
    bool onLiveHostsOnly = false; ///< of a snapshot it is read-only
};

/// The node's changing property of that number; null where it has none.
const ChangingProperty* changingProperty(const Node& node, unsigned int number);

/// The node's status now, which includes what may change at any time.
unsigned int statusOf(HostNow& host, const Node& node);

/// Reads all that a host's nodes are made of, for a root that keeps a record.
void readEverything(const Root& root);

} // namespace VK::Tree
