#pragma once

#include "tree/NodeSource.h"

#include <memory>
#include <optional>
#include <string>
#include <utility>

namespace VK::Tree {

/// What VK::Instrumentation is made of: a place among the nodes of one type, or on one node, of a host's tree as it
/// stood when the nodes were selected. A node's name and status are read once while the cursor stands on it: what one
/// answer says of them belongs to one moment.
class Cursor {
public:
    /// Over the host of this process.
    Cursor();
    explicit Cursor(NodeSource& ofHost) : host(ofHost) {}

    void selectType(unsigned int type);
    void selectPath(const std::string& path);
    /// The node that the cursor stands on, or null.
    const Node* node() const { return current; }
    void advance();
    void filterByPath(const std::string& path);
    /// Moves off the end, for filters that no node passes.
    void finish() { standOn(nullptr); }

    std::optional<Value> read(unsigned int property) const;
    /// Hands out a property that is of the kind asked for.
    template <typename T>
    bool read(unsigned int property, T& value) const {
        std::optional<Value> changing;
        const Value* const found = find(property, changing);
        const T* const content = found != nullptr ? std::get_if<T>(found) : nullptr;
        if (content != nullptr) value = *content;
        return content != nullptr;
    }
    bool write(unsigned int property, const Value& value);
    std::optional<bool> isReadOnly(unsigned int property) const;
    unsigned int status() const;

private:
    void standOn(const Node* node);
    /// A property, or null; `changing` holds one that may change at any time.
    const Value* find(unsigned int property, std::optional<Value>& changing) const;

    NodeSource& host;
    std::shared_ptr<const NodeTree> tree;
    const NodeTree::Nodes* sameType = nullptr; ///< what ++ walks along; null after selectPath
    std::size_t rank = 0;
    const Node* current = nullptr;
    bool filtered = false;
    // Of the current node, once read.
    mutable std::optional<unsigned int> knownStatus;
    mutable std::optional<std::optional<Value>> knownName;
};

} // namespace VK::Tree
