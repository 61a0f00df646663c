#include "tree/RealHost.h"

#include "logger/LogLine.h"
#include "tree/HostNodes.h"

#include <cerrno>

namespace VK::Tree {

namespace {

RealHost::Reading readOnce(const Root& root) {
    RealHost::Reading reading;
    std::vector<Node> all;
    reading.problem = problemOf(root);
    if (reading.problem.empty()) {
        reading.facts = Host::readHardware(root);
        all = hostNodes(reading.facts);
    }
    reading.tree = std::make_shared<const NodeTree>(std::move(all));
    return reading;
}

void logProblems(const RealHost::Reading& reading) {
    const Host::HardwareFacts& facts = reading.facts;
    if (!reading.problem.empty()) logLine(failure, "readOnce", __LINE__, reading.problem);
    for (const std::string& problem : facts.problems) logLine(failure, "readOnce", __LINE__, problem);
    if (const Host::Fact& none = facts.noTables; none.error != 0 && facts.problems.empty()) // damage is logged above
        logLine(none.error == ENOENT ? detail : notice, "readOnce", __LINE__,
                "no SMBIOS tables: " + none.source + ": " + errorText(none.error));
}

} // namespace

std::string problemOf(const Root& root) {
    const Root::Names top = root.list("/");
    return top ? std::string() : root.getDirectory() + ": " + errorText(top.error);
}

std::shared_ptr<const RealHost::Reading> RealHost::reading() {
    return known.get([this] { return readOnce(root); }, logProblems);
}

std::shared_ptr<const NodeTree> RealHost::tree() {
    return reading()->tree;
}

std::optional<Value> RealHost::read(const Node& node, unsigned int property) {
    const auto found = node.properties.find(property);
    if (found != node.properties.end()) return found->second;
    const ChangingProperty* const changing = changingProperty(node, property);
    return changing != nullptr ? changing->read(now) : std::nullopt;
}

bool RealHost::write(const Node& node, unsigned int property, const Value& value) {
    const ChangingProperty* const changing = changingProperty(node, property);
    if (changing != nullptr && changing->change != nullptr)
        if (const std::optional<bool> changed = changing->change(root, value)) {
            now.forget();
            return *changed;
        }
    logLine(failure, "setProperty", __LINE__,
            "property " + std::to_string(property) + " of " + node.path + " cannot be written so");
    return false;
}

std::optional<bool> RealHost::isReadOnly(const Node& node, unsigned int property) {
    const ChangingProperty* const changing = changingProperty(node, property);
    return changing == nullptr || changing->change == nullptr || (changing->onLiveHostsOnly && !root.isLive());
}

unsigned int RealHost::status(const Node& node) {
    return statusOf(now, node);
}

} // namespace VK::Tree
