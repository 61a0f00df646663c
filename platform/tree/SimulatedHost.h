#pragma once

#include "tree/NodeSource.h"
#include "vk/HostFacts.h"

#include <cstdint>
#include <mutex>
#include <string>
#include <sys/stat.h>
#include <tuple>

namespace VK::Tree {

/// A host that a JSON file describes. The file may change at any time; it is parsed anew only when it did.
class SimulatedHost final : public NodeSource {
public:
    /// The largest file that is read at all.
    static constexpr std::size_t LARGEST_FILE = std::size_t{16} << 20;

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
    /// Tells whether a file is still the one that was read.
    struct Stamp {
        std::tuple<dev_t, ino_t, off_t, time_t, long, time_t, long> identity{};
        std::int64_t changed = 0; ///< nanoseconds since 1970
        int error = 0;            ///< why there is no file, instead of all else
    };

    static Stamp stampOf(const struct stat& status);
    Stamp stampNow() const;
    bool isKnown(const Stamp& now) const;
    void readAnew();
    std::string refusal(const Node& node, unsigned int property, const Value& value) const;

    const std::string file;
    std::mutex mutex;
    std::shared_ptr<const State> known;
    Stamp stamp;
    bool settled = false; ///< the stamp tells every later change
};

} // namespace VK::Tree
