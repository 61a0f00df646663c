#include "tree/SimulatedHost.h"

#include "common/HostLook.h"
#include "common/Text.h"
#include "logger/LogLine.h"
#include "tree/TreeFile.h"
#include "tree/TreeText.h"
#include "vk/Kept.h"

#include <algorithm>

namespace VK::Tree {

namespace {

bool contains(const std::vector<unsigned int>& numbers, unsigned int number) {
    return std::find(numbers.begin(), numbers.end(), number) != numbers.end();
}

} // namespace

std::optional<Value> SimulatedHost::read(const Node& node, unsigned int property) {
    const auto found = node.properties.find(property);
    return found == node.properties.end() ? std::nullopt : std::optional<Value>(found->second);
}

std::optional<bool> SimulatedHost::isReadOnly(const Node& node, unsigned int property) {
    if (contains(node.unanswerable, property)) return std::nullopt;
    return contains(node.readOnly, property);
}

std::string SimulatedHost::refusal(const Node& node, unsigned int property, const Value& value) const {
    if (contains(node.readOnly, property)) return "it is read-only";
    if (contains(node.failWrites, property)) return "its writing fails";
    const auto found = node.properties.find(property);
    if (found != node.properties.end() && found->second.index() != value.index())
        return found->second.index() == 0 ? "it holds a text" : "it holds a number";
    return {};
}

bool SimulatedHost::write(const Node& node, unsigned int property, const Value& value) {
    const auto change = [&](const std::string& text, std::string& problem) -> std::string {
        TreeText current = readTreeText(text);
        problem = current.problem;
        if (!problem.empty()) return {};
        const auto found = std::find_if(current.nodes.begin(), current.nodes.end(),
                                        [&node](const Node& each) { return each.path == node.path; });
        problem = found == current.nodes.end() ? "the node is gone" : refusal(*found, property, value);
        if (!problem.empty()) return {};
        std::string changed = changeTreeText(text, node.path, property, value);
        if (changed.empty()) problem = "the text is not UTF-8, or has a zero byte";
        return changed;
    };
    const std::string problem = replaceTreeFile(file, largestFile, change);
    HostLook::forget(this); // what we wrote shows at once
    if (problem.empty()) return true;
    logLine(failure, "setProperty", __LINE__,
            file + ": property " + std::to_string(property) + " of " + inQuotes(node.path) +
                " not written: " + problem);
    return false;
}

std::shared_ptr<const SimulatedHost::State> SimulatedHost::state() {
    return HostLook::once<State>(this, [this] { return asked(); });
}

std::shared_ptr<const SimulatedHost::State> SimulatedHost::asked() {
    const FileStamp at = FileStamp::behind(file.c_str());
    ReadPointer read = known.get();
    if (!read || !read->settled || at != read->stamp) {
        Read fresh = readAnew();
        // At a shortage what is known stays, and is asked for again the next time.
        if (!read || !isShortage(fresh.stamp.error)) read = keep(std::move(fresh));
    }
    return {read, &read->state};
}

SimulatedHost::Read SimulatedHost::readAnew() const {
    Read fresh;
    const std::int64_t begin = FileStamp::now();
    const TreeFileContents contents = readTreeFile(file, largestFile);
    TreeText text;
    text.problem = contents.problem;
    if (text.problem.empty()) text = readTreeText(contents.text);
    fresh.state.tree = std::make_shared<const NodeTree>(std::move(text.nodes));
    fresh.state.product = std::move(text.product);
    fresh.state.problem = std::move(text.problem);
    fresh.stamp = contents.error != 0 ? FileStamp() : FileStamp(contents.status);
    fresh.stamp.error = contents.error;
    fresh.settled = fresh.stamp.tellsChangesFrom(begin) && hasExactStamps(file);
    return fresh;
}

SimulatedHost::ReadPointer SimulatedHost::keep(Read fresh) {
    const auto now = std::make_shared<const Read>(std::move(fresh));
    const ReadPointer before = known.exchange(now);
    const std::string& problem = now->state.problem;
    if (!problem.empty() && (!before || problem != before->state.problem))
        logLine(failure, "readAnew", __LINE__, file + ": " + problem);
    return now;
}

} // namespace VK::Tree
