#pragma once

#include "common/FileStamp.h"
#include "common/Published.h"
#include "tree/NodeSource.h"
#include "vk/HostFacts.h"

#include <string>

namespace VK::Tree {

/// A host that a JSON file describes. The file may change at any time; it is parsed anew only when it did.
class SimulatedHost final : public NodeSource {
public:
    /// The largest file that is read at all.
    static constexpr std::size_t largestFile = std::size_t{16} << 20;

    /// What a file was like when it was read.
    struct State {
        std::shared_ptr<const NodeTree> tree; ///< never null
        ProductOverrides product;
        std::string problem; ///< why the tree is empty; empty when it was read
    };

    explicit SimulatedHost(std::string treeFile) : file(std::move(treeFile)) {}

    std::shared_ptr<const NodeTree> tree() override { return state()->tree; }
    std::optional<Value> read(const Node& node, unsigned int property) override;
    bool write(const Node& node, unsigned int property, const Value& value) override;
    std::optional<bool> isReadOnly(const Node& node, unsigned int property) override;
    unsigned int status(const Node& node) override { return node.status; }

    /// The file as it stands now. A file that cannot be used is logged once in each state that it is found in.
    std::shared_ptr<const State> state();

private:
    /// A state, and what the file was like then.
    struct Read {
        State state;
        FileStamp stamp;
        bool settled = false; ///< the stamp shows every later change
    };
    using ReadPointer = Published<Read>::Pointer;

    std::shared_ptr<const State> asked();
    Read readAnew() const;
    ReadPointer keep(Read fresh);
    std::string refusal(const Node& node, unsigned int property, const Value& value) const;

    const std::string file;
    Published<Read> known;
};

} // namespace VK::Tree
