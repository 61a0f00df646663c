#include "tree/RealHost.h"

#include "host/State.h"
#include "logger/LogLine.h"
#include "tree/HostNodes.h"
#include "vk/NodeLexicon.h"
#include "zone/Clock.h"
#include "zone/ZoneChange.h"

#include <algorithm>
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
    return node.type == NodeLexicon::ComputerSystemNode ? changingProperty(root, property) : std::nullopt;
}

bool RealHost::write(const Node& node, unsigned int property, const Value& value) {
    const std::string* text = std::get_if<std::string>(&value);
    const unsigned int* number = std::get_if<unsigned int>(&value);
    if (node.type == NodeLexicon::ComputerSystemNode) {
        if (property == NodeLexicon::SystemTimeProperty && text != nullptr) return Zone::changeClock(root, *text);
        if (property == NodeLexicon::GmtOffsetProperty && number != nullptr)
            return Zone::changeOffset(root, static_cast<int>(*number)); // two's complement
        if (property == NodeLexicon::AutomaticDSTAdjustmentProperty && number != nullptr && *number <= 1)
            return Zone::changeDaylightSaving(root, *number == 1);
    }
    logLine(FAILURE, "setProperty", __LINE__,
            "property " + std::to_string(property) + " of " + node.path + " cannot be written so");
    return false;
}

std::optional<bool> RealHost::isReadOnly(const Node& node, unsigned int property) {
    if (node.type != NodeLexicon::ComputerSystemNode) return true;
    switch (property) {
    case NodeLexicon::SystemTimeProperty:
        return !root.isLive();
    case NodeLexicon::GmtOffsetProperty:
    case NodeLexicon::AutomaticDSTAdjustmentProperty:
        return false;
    default:
        return true;
    }
}

unsigned int RealHost::status(const Node& node) {
    constexpr unsigned int UNCORRECTABLE_ERRORS = 22;
    if (node.type == NodeLexicon::ComputerSystemNode && Host::hasUncorrectableMemoryErrors(root))
        return std::max(node.status, UNCORRECTABLE_ERRORS); // the worse, the larger
    return node.status;
}

} // namespace VK::Tree
