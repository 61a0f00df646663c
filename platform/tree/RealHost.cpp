#include "tree/RealHost.h"

#include "logger/LogLine.h"
#include "tree/HostNodes.h"

#include <cerrno>

namespace VK::Tree {

namespace {

void logProblems(const Host::HardwareFacts& facts) {
    for (const std::string& problem : facts.problems) logLine(FAILURE, "readOnce", __LINE__, problem);
    if (const Host::Fact& none = facts.noTables; none.error != 0 && facts.problems.empty()) // damage is logged above
        logLine(none.error == ENOENT ? DETAIL : NOTICE, "readOnce", __LINE__,
                "no SMBIOS tables: " + none.source + ": " + errorText(none.error));
}

} // namespace

void RealHost::readOnce() {
    std::call_once(once, [this] {
        std::vector<Node> all;
        if (const Root::Names top = root.list("/"); !top) {
            rootProblem = root.getDirectory() + ": " + errorText(top.error);
            logLine(FAILURE, "readOnce", __LINE__, rootProblem);
        } else {
            facts = Host::readHardware(root);
            logProblems(facts);
            all = hostNodes(facts);
        }
        nodes = std::make_shared<const NodeTree>(std::move(all));
    });
}

std::shared_ptr<const NodeTree> RealHost::tree() {
    readOnce();
    return nodes;
}

const Host::HardwareFacts& RealHost::hardware() {
    readOnce();
    return facts;
}

const std::string& RealHost::problem() {
    readOnce();
    return rootProblem;
}

std::optional<Value> RealHost::read(const Node& node, unsigned int property) {
    const auto found = node.properties.find(property);
    if (found != node.properties.end()) return found->second;
    const ChangingProperty* const changing = changingProperty(node, property);
    return changing != nullptr ? changing->read(root) : std::nullopt;
}

bool RealHost::write(const Node& node, unsigned int property, const Value& value) {
    const ChangingProperty* const changing = changingProperty(node, property);
    if (changing != nullptr && changing->change != nullptr)
        if (const std::optional<bool> changed = changing->change(root, value)) return *changed;
    logLine(FAILURE, "setProperty", __LINE__,
            "property " + std::to_string(property) + " of " + node.path + " cannot be written so");
    return false;
}

std::optional<bool> RealHost::isReadOnly(const Node& node, unsigned int property) {
    const ChangingProperty* const changing = changingProperty(node, property);
    return changing == nullptr || changing->change == nullptr || (changing->onLiveHostsOnly && !root.isLive());
}

unsigned int RealHost::status(const Node& node) {
    return statusOf(root, node);
}

} // namespace VK::Tree
