#pragma once

#include "host/HardwareFacts.h"
#include "tree/NodeSource.h"

#include <memory>
#include <mutex>

namespace VK::Tree {

/// This host, or a snapshot of one below another root. What cannot change while a host runs is read once.
class RealHost final : public NodeSource {
public:
    explicit RealHost(const Root& hostRoot) : root(hostRoot) {}

    std::shared_ptr<const NodeTree> tree() override;
    std::optional<Value> read(const Node& node, unsigned int property) override;
    bool write(const Node& node, unsigned int property, const Value& value) override;
    std::optional<bool> isReadOnly(const Node& node, unsigned int property) override;
    unsigned int status(const Node& node) override;

    /// The facts behind the tree.
    const Host::HardwareFacts& hardware();
    /// The problem of a root that cannot be used, or an empty text.
    const std::string& problem();

private:
    void readOnce();

    const Root root;
    std::once_flag once;
    Host::HardwareFacts facts;
    std::string rootProblem;
    std::shared_ptr<const NodeTree> nodes;
};

} // namespace VK::Tree
