#include "fuzz/RandomHost.h"

#include <nlohmann/json.hpp>

#include <algorithm>

namespace fuzz {
namespace {

using nlohmann::json;

constexpr unsigned computerNode = 40;
constexpr unsigned chassisNode = 1;
constexpr char nameProperty[] = "108";
constexpr char serialProperty[] = "50";
constexpr std::array<const char*, 3> types = {"40", "1", "7"};
constexpr std::array<const char*, 5> paths = {"/computer/0", "/computer/1", "/chassis/0", "/chassis/1", "/fan"};
constexpr std::array<const char*, 4> parents = {"/computer/0", "/computer/1", "", "/nowhere"};
constexpr std::array<const char*, 14> properties = {"108", "50",  "39",  "64",  "36", "86",  "128",
                                                    "123", "200", "127", "126", "1",  "109", "4294967295"};

std::string dump(const json& value) {
    return value.dump(-1, ' ', false, json::error_handler_t::replace);
}

/// UTF-8 without NUL, which no text of a host has, and which ends a text on its way through the object manager.
template <std::size_t Size>
std::string text(Choices& choices, const std::array<const char*, Size>& known) {
    std::string made = choices.text(known);
    made.erase(std::remove(made.begin(), made.end(), '\0'), made.end());
    return json::parse(dump(made)).get<std::string>();
}

json value(Choices& choices, const std::string& hostName) {
    constexpr std::array<unsigned, 8> numbers = {0, 1, 2, 6, 7, 16, 4294966996U, 4294967295U};
    switch (choices.below(6)) {
    case 0:
        return numbers[choices.below(numbers.size())];
    case 1:
        return hostName;
    default:
        return text(choices, nodeNames);
    }
}

json numbersOf(Choices& choices) {
    json list = json::array();
    for (std::size_t i = choices.below(3); i > 0; --i) list.push_back(std::stoul(choices.one(properties)));
    return list;
}

json node(Choices& choices, const std::string& hostName) {
    json made = {{"type", std::stoul(choices.one(types))}, {"path", text(choices, paths)}};
    made["parent"] = text(choices, parents);
    made["status"] = choices.below(32);
    made["description"] = text(choices, nodeNames);
    made["properties"] = json::object();
    // The property that identifies an element is set more often than chance would have it.
    if (!choices.oneIn(4))
        made["properties"][made["type"] == computerNode ? nameProperty : serialProperty] = value(choices, hostName);
    for (std::size_t i = choices.below(6); i > 0; --i)
        made["properties"][choices.one(properties)] = value(choices, hostName);
    for (const char* list : {"readOnly", "unanswerable", "failWrites"})
        if (choices.oneIn(3)) made[list] = numbersOf(choices);
    return made;
}

/// What identifies a node.
std::optional<std::string> identity(const json& made, const char* property) {
    const auto found = made["properties"].find(property);
    if (found == made["properties"].end() || !found->is_string()) return std::nullopt;
    return found->get<std::string>();
}

} // namespace

RandomHost randomHost(Choices& choices, const std::string& hostName) {
    RandomHost host;
    json nodes = json::array();
    for (std::size_t i = choices.below(8); i > 0; --i) {
        json made = node(choices, hostName);
        if (made["type"] == computerNode) host.computers.push_back(identity(made, nameProperty));
        if (made["type"] == chassisNode) host.chassis.push_back(identity(made, serialProperty));
        nodes.push_back(std::move(made));
    }
    host.json = dump({{"product", {{"architecture", "x86_64"}, {"uid", "1"}, {"kvm", false}}}, {"nodes", nodes}});
    return host;
}

} // namespace fuzz
