#pragma once

#include "host/HardwareFacts.h"
#include "tree/HostNow.h"
#include "tree/NodeSource.h"
#include "vk/Kept.h"

#include <memory>
#include <string>

namespace VK::Tree {

/// Why the directory of a root cannot be read, with its name; empty where it can.
std::string problemOf(const Root& root);

/// This host, or a snapshot of one below another root. What cannot change while a host runs is read once.
class RealHost final : public NodeSource {
public:
    explicit RealHost(const Root& hostRoot) : root(hostRoot), now(root) {}

    std::shared_ptr<const NodeTree> tree() override;
    std::optional<Value> read(const Node& node, unsigned int property) override;
    bool write(const Node& node, unsigned int property, const Value& value) override;
    std::optional<bool> isReadOnly(const Node& node, unsigned int property) override;
    unsigned int status(const Node& node) override;

    /// What cannot change while a host runs.
    struct Reading {
        Host::HardwareFacts facts;            ///< behind the tree
        std::string problem;                  ///< of a root that cannot be used; empty when it can
        std::shared_ptr<const NodeTree> tree; ///< never null
    };
    /// Never null. Read again the next time where descriptors ran out.
    std::shared_ptr<const Reading> reading();

private:
    const Root root;
    Kept<Reading> known;
    HostNow now;
};

} // namespace VK::Tree
