#include "fuzz/Expect.h"
#include "tree/TreeText.h"

#include <tuple>

namespace {

using namespace VK::Tree;
using fuzz::expect;

auto allOf(const Node& node) {
    return std::tie(node.type, node.path, node.parent, node.status, node.description, node.properties, node.readOnly,
                    node.unanswerable, node.failWrites);
}

auto allOf(const VK::ProductOverrides& product) {
    return std::tie(product.architecture, product.uid, product.rootDirectory, product.kvm);
}

void checkSame(const TreeText& one, const TreeText& other) {
    expect(one.problem == other.problem && one.nodes.size() == other.nodes.size(), "another number of nodes");
    expect(allOf(one.product) == allOf(other.product), "the product is another");
    for (std::size_t i = 0; i < one.nodes.size(); ++i)
        expect(allOf(one.nodes[i]) == allOf(other.nodes[i]), "a node is another");
}

} // namespace

/// What is read is read the same again, and with one change in it after one property was changed.
extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    TreeText tree = readTreeText(text);
    checkSame(readTreeText(text), tree);
    if (!tree.problem.empty()) expect(tree.nodes.empty() && !tree.product.uid, "a refused text was read");
    if (tree.nodes.empty()) return 0;
    Node& node = tree.nodes.back();
    const std::string changed = changeTreeText(text, node.path, 4711, Value("changed"));
    node.properties[4711] = Value("changed");
    checkSame(readTreeText(changed), tree);
    return 0;
}
