#include "tree/NodeTree.h"

#include <utility>

namespace VK::Tree {

NodeTree::NodeTree(std::vector<Node> all) : nodes(std::move(all)) {
    byPath.reserve(nodes.size());
    for (const Node& node : nodes) {
        Nodes& sameType = byType[node.type];
        byPath.emplace(node.path, Place{&node, sameType.size()});
        sameType.push_back(&node);
    }
}

const NodeTree::Nodes& NodeTree::ofType(unsigned int type) const {
    static const Nodes none;
    const auto found = byType.find(type);
    return found == byType.end() ? none : found->second;
}

NodeTree::Place NodeTree::find(const std::string& path) const {
    const auto found = byPath.find(path);
    return found == byPath.end() ? Place{} : found->second;
}

} // namespace VK::Tree
