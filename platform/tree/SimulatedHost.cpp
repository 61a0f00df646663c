#include "tree/SimulatedHost.h"

#include "common/Text.h"
#include "logger/LogLine.h"
#include "tree/TreeFile.h"
#include "tree/TreeText.h"

#include <algorithm>
#include <cerrno>
#include <ctime>

namespace VK::Tree {

namespace {

/// Two changes within one tick of the file system's clock leave the same stamp: one as young as this may still be
/// followed by a change that it does not tell.
constexpr std::int64_t CLOCK_TICK = 20'000'000;

std::int64_t nanoseconds(const timespec& time) {
    return std::int64_t{time.tv_sec} * 1'000'000'000 + time.tv_nsec;
}

std::int64_t now() {
    timespec time{};
    clock_gettime(CLOCK_REALTIME, &time);
    return nanoseconds(time);
}

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
    const std::string problem = replaceTreeFile(file, LARGEST_FILE, change);
    if (problem.empty()) return true;
    logLine(FAILURE, "setProperty", __LINE__,
            file + ": property " + std::to_string(property) + " of " + inQuotes(node.path) +
                " not written: " + problem);
    return false;
}

SimulatedHost::Stamp SimulatedHost::stampOf(const struct stat& status) {
    Stamp result;
    result.identity = {status.st_dev,          status.st_ino,         status.st_size,        status.st_mtim.tv_sec,
                       status.st_mtim.tv_nsec, status.st_ctim.tv_sec, status.st_ctim.tv_nsec};
    result.changed = nanoseconds(status.st_ctim); // set by the kernel alone, with every change
    return result;
}

SimulatedHost::Stamp SimulatedHost::stampNow() const {
    struct stat status {};
    if (stat(file.c_str(), &status) == 0) return stampOf(status);
    Stamp result;
    result.error = errno;
    return result;
}

bool SimulatedHost::isKnown(const Stamp& at) const {
    return known && settled && at.error == stamp.error && at.identity == stamp.identity;
}

std::shared_ptr<const SimulatedHost::State> SimulatedHost::state() {
    const Stamp at = stampNow();
    const std::lock_guard<std::mutex> lock(mutex);
    if (!isKnown(at)) readAnew();
    return known;
}

void SimulatedHost::readAnew() {
    const std::string before = known ? known->problem : std::string();
    const std::int64_t begin = now();
    const TreeFileContents contents = readTreeFile(file, LARGEST_FILE);
    auto fresh = std::make_shared<State>();
    TreeText text;
    text.problem = contents.problem;
    if (text.problem.empty()) text = readTreeText(contents.text);
    fresh->tree = std::make_shared<const NodeTree>(std::move(text.nodes));
    fresh->product = std::move(text.product);
    fresh->problem = std::move(text.problem);
    if (!fresh->problem.empty() && fresh->problem != before)
        logLine(FAILURE, "readAnew", __LINE__, file + ": " + fresh->problem);
    stamp = contents.error != 0 ? Stamp() : stampOf(contents.status);
    stamp.error = contents.error;
    settled = contents.error != 0 || stamp.changed + CLOCK_TICK < begin;
    known = std::move(fresh);
}

} // namespace VK::Tree
