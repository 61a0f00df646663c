#pragma once

#include "tree/NodeTree.h"
#include "vk/HostFacts.h"

#include <string>
#include <string_view>
#include <vector>

namespace VK::Tree {

/// A simulated host's file, read.
struct TreeText {
    std::vector<Node> nodes;
    ProductOverrides product;
    std::string problem; ///< why the text was refused and where (`nodes[3].status: ...`); empty when it was not
};

/// No consumer of a text sees what stands behind a zero byte: such a text does not go into a tree.
bool hasZeroByte(const std::string& text);

/// Reads the JSON text of a simulated host. Unknown keys, keys and paths given twice, and values that do not fit
/// are refused; then there are no nodes and no overrides.
TreeText readTreeText(std::string_view text);

/// The text with one property of the node at `path` changed or added; everything else keeps its value and its
/// order. Empty when the text cannot be read or has no such node, or the value is no UTF-8 or has a zero byte.
std::string changeTreeText(std::string_view text, const std::string& path, unsigned int property, const Value& value);

} // namespace VK::Tree
