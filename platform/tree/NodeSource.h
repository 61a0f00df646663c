#pragma once

#include "tree/NodeTree.h"

#include <memory>
#include <optional>

namespace VK::Tree {

/// A host as cursors see it: this one, a snapshot of one or a simulated one. Any number of threads may use it.
class NodeSource {
public:
    NodeSource() = default;
    virtual ~NodeSource() = default;
    NodeSource(const NodeSource&) = delete;
    NodeSource& operator=(const NodeSource&) = delete;

    /// The tree as it stands now; never null.
    virtual std::shared_ptr<const NodeTree> tree() = 0;

    /// What a property of a node holds now.
    virtual std::optional<Value> read(const Node& node, unsigned int property) = 0;

    /// Writes a property: true, or false and a log line that says why.
    virtual bool write(const Node& node, unsigned int property, const Value& value) = 0;

    /// Whether a property can only be read; nothing where that is not known.
    virtual std::optional<bool> isReadOnly(const Node& node, unsigned int property) = 0;

    /// The node's status now.
    virtual unsigned int status(const Node& node) = 0;

    /// The host of this process (vk/HostSource.h), made when first asked for.
    static NodeSource& current();
};

} // namespace VK::Tree
