#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <string_view>
#include <unordered_map>
#include <variant>
#include <vector>

namespace VK::Tree {

/// What a property holds: a text or a number.
using Value = std::variant<std::string, unsigned int>;

struct Node {
    unsigned int type = 0;
    std::string path;
    std::string parent;
    unsigned int status = 0;
    std::string description;
    std::map<unsigned int, Value> properties;
    std::vector<unsigned int> readOnly;     ///< properties that nobody can write
    std::vector<unsigned int> unanswerable; ///< properties of which nobody knows whether they can be written
    std::vector<unsigned int> failWrites;   ///< properties whose writing fails
};

/// Nodes in a fixed order, with an index by type and one by path, so that a cursor's steps cost the same in a large
/// tree. Never changed once made; any number of threads may read it.
class NodeTree {
public:
    using Nodes = std::vector<const Node*>;

    /// A node and how many nodes of its type come before it.
    struct Place {
        const Node* node = nullptr;
        std::size_t rank = 0;
    };

    NodeTree() = default;
    /// Where a path is given twice, the first node has it.
    explicit NodeTree(std::vector<Node> all);
    NodeTree(const NodeTree&) = delete;
    NodeTree& operator=(const NodeTree&) = delete;

    /// The nodes of a type, in order.
    const Nodes& ofType(unsigned int type) const;
    /// The node with this path; a place with a null node when there is none.
    Place find(const std::string& path) const;
    bool isEmpty() const { return nodes.empty(); }

private:
    std::vector<Node> nodes;
    std::unordered_map<unsigned int, Nodes> byType;
    std::unordered_map<std::string_view, Place> byPath;
};

} // namespace VK::Tree
