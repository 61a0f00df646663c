#include "tree/TreeText.h"

#include "common/Text.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <limits>
#include <unordered_set>

namespace VK::Tree {

namespace {

using Json = nlohmann::ordered_json;

/// Ends the reading; `problem` names the place in the document and what is wrong there.
struct Refusal {
    std::string problem;
};

[[noreturn]] void refuse(const std::string& where, const std::string& what) {
    throw Refusal{where.empty() ? what : where + ": " + what};
}

std::string kindOf(const Json& value) {
    if (value.is_null()) return "null";
    if (value.is_boolean()) return "true or false";
    if (value.is_string()) return "text";
    if (value.is_array()) return "array";
    if (value.is_object()) return "object";
    return "number " + inQuotes(value.dump());
}

[[noreturn]] void refuseKind(const std::string& where, const Json& value, const char* expected) {
    refuse(where, kindOf(value) + " instead of " + expected);
}

unsigned int wholeNumber(const std::string& where, const Json& value) {
    if (!value.is_number_unsigned() || value.get<std::uint64_t>() > std::numeric_limits<unsigned int>::max())
        refuseKind(where, value, "a whole number from 0 to 4294967295");
    return value.get<unsigned int>();
}

std::string textOf(const std::string& where, const Json& value) {
    if (!value.is_string()) refuseKind(where, value, "a text");
    std::string text = value.get<std::string>();
    if (hasZeroByte(text)) refuse(where, "text with a zero byte");
    return text;
}

const Json& object(const std::string& where, const Json& value) {
    if (!value.is_object()) refuseKind(where, value, "an object");
    return value;
}

const Json& array(const std::string& where, const Json& value) {
    if (!value.is_array()) refuseKind(where, value, "an array");
    return value;
}

std::string element(const std::string& where, std::size_t index) {
    return where + "[" + std::to_string(index) + "]";
}

/// A property's number in decimal as people write it: no sign, no needless zeros.
unsigned int propertyNumber(const std::string& where, const std::string& name) {
    unsigned int number = 0;
    const char* const end = name.data() + name.size();
    const auto read = std::from_chars(name.data(), end, number);
    if (read.ec != std::errc() || read.ptr != end || (name.size() > 1 && name.front() == '0'))
        refuse(where, "property " + inQuotes(name) + " is not a number in decimal");
    return number;
}

void takeProperties(const std::string& where, const Json& value, std::map<unsigned int, Value>& properties) {
    for (const auto& [name, content] : object(where, value).items()) {
        Value& property = properties[propertyNumber(where, name)];
        const std::string at = where + "." + name;
        if (content.is_string())
            property = textOf(at, content);
        else
            property = wholeNumber(at, content);
    }
}

void takeNumbers(const std::string& where, const Json& value, std::vector<unsigned int>& numbers) {
    for (std::size_t i = 0; i < array(where, value).size(); ++i)
        numbers.push_back(wholeNumber(element(where, i), value[i]));
}

/// A key of an object and what its value fills in.
template <typename Target>
struct Key {
    const char* name;
    void (*take)(Target& target, const std::string& where, const Json& value);
};

using At = const std::string&;

constexpr Key<ProductOverrides> productKeys[] = {
    {"architecture", [](ProductOverrides& to, At at, const Json& value) { to.architecture = textOf(at, value); }},
    {"uid", [](ProductOverrides& to, At at, const Json& value) { to.uid = textOf(at, value); }},
    {"rootDirectory", [](ProductOverrides& to, At at, const Json& value) { to.rootDirectory = textOf(at, value); }},
    {"kvm",
     [](ProductOverrides& to, At at, const Json& value) {
         if (!value.is_boolean()) refuseKind(at, value, "true or false");
         to.kvm = value.get<bool>();
     }},
};

constexpr Key<Node> nodeKeys[] = {
    {"type", [](Node& to, At at, const Json& value) { to.type = wholeNumber(at, value); }},
    {"path",
     [](Node& to, At at, const Json& value) {
         to.path = textOf(at, value);
         if (to.path.empty()) refuse(at, "empty path");
     }},
    {"parent", [](Node& to, At at, const Json& value) { to.parent = textOf(at, value); }},
    {"status", [](Node& to, At at, const Json& value) { to.status = wholeNumber(at, value); }},
    {"description", [](Node& to, At at, const Json& value) { to.description = textOf(at, value); }},
    {"properties", [](Node& to, At at, const Json& value) { takeProperties(at, value, to.properties); }},
    {"readOnly", [](Node& to, At at, const Json& value) { takeNumbers(at, value, to.readOnly); }},
    {"unanswerable", [](Node& to, At at, const Json& value) { takeNumbers(at, value, to.unanswerable); }},
    {"failWrites", [](Node& to, At at, const Json& value) { takeNumbers(at, value, to.failWrites); }},
};

template <typename Target, std::size_t N>
void takeKeys(Target& target, const Key<Target> (&keys)[N], const std::string& where, const Json& value) {
    for (const auto& [name, content] : object(where, value).items()) {
        const auto* key = std::find_if(std::begin(keys), std::end(keys),
                                       [&name = name](const Key<Target>& one) { return name == one.name; });
        if (key == std::end(keys)) refuse(where, "unknown key " + inQuotes(name));
        key->take(target, where.empty() ? name : where + "." + name, content);
    }
}

void takeNodes(TreeText& tree, const std::string& where, const Json& value) {
    std::unordered_set<std::string> paths;
    for (std::size_t i = 0; i < array(where, value).size(); ++i) {
        const std::string at = element(where, i);
        Node node;
        takeKeys(node, nodeKeys, at, value[i]);
        for (const char* required : {"type", "path"})
            if (!value[i].contains(required)) refuse(at, "no \"" + std::string(required) + "\"");
        if (!paths.insert(node.path).second) refuse(at + ".path", "path " + inQuotes(node.path) + " is given twice");
        tree.nodes.push_back(std::move(node));
    }
}

constexpr Key<TreeText> documentKeys[] = {
    {"product", [](TreeText& to, At at, const Json& value) { takeKeys(to.product, productKeys, at, value); }},
    {"nodes", takeNodes},
};

/// Follows the parser, whose document would hide a key that is given twice.
class GivenTwice {
public:
    bool operator()(int, Json::parse_event_t event, Json& parsed) {
        using Event = Json::parse_event_t;
        switch (event) {
        case Event::key:
            open.back().key = parsed.get<std::string>();
            if (!open.back().keys.insert(open.back().key).second)
                refuse(place(), "key " + inQuotes(open.back().key) + " is given twice");
            break;
        case Event::object_start:
        case Event::array_start:
            open.push_back({event == Event::array_start, 0, {}, {}});
            break;
        case Event::object_end:
        case Event::array_end:
            open.pop_back();
            [[fallthrough]];
        case Event::value:
            if (!open.empty()) ++open.back().index;
            break;
        }
        return true;
    }

private:
    struct Level {
        bool isArray;
        std::size_t index;
        std::string key;
        std::unordered_set<std::string> keys;
    };

    /// Where the innermost open object stands.
    std::string place() const {
        std::string where;
        for (std::size_t i = 0; i + 1 < open.size(); ++i) {
            if (open[i].isArray)
                where = element(where, open[i].index);
            else
                where += (where.empty() ? "" : ".") + open[i].key;
        }
        return where;
    }

    std::vector<Level> open;
};

TreeText read(std::string_view text) {
    TreeText tree;
    const Json document = Json::parse(text, GivenTwice());
    takeKeys(tree, documentKeys, "", document);
    if (!document.contains("nodes")) refuse("", "no \"nodes\"");
    return tree;
}

TreeText refused(const std::string& problem) {
    TreeText tree;
    tree.problem = problem;
    return tree;
}

Json* findNode(Json& document, const std::string& path) {
    for (Json& node : document["nodes"])
        if (node["path"] == path) return &node;
    return nullptr;
}

} // namespace

bool hasZeroByte(const std::string& text) {
    return text.find('\0') != std::string::npos;
}

TreeText readTreeText(std::string_view text) {
    try {
        return read(text);
    } catch (const Refusal& refusal) {
        return refused(refusal.problem);
    } catch (const Json::parse_error& error) {
        return refused("not JSON at byte " + std::to_string(error.byte));
    } catch (const Json::out_of_range&) {
        return refused("a number that is too large for JSON");
    }
}

std::string changeTreeText(std::string_view text, const std::string& path, unsigned int property, const Value& value) {
    if (const auto* content = std::get_if<std::string>(&value); content != nullptr && hasZeroByte(*content)) return {};
    Json document = Json::parse(text, nullptr, false);
    if (document.is_discarded()) return {};
    Json* node = findNode(document, path);
    if (node == nullptr) return {};
    Json& place = (*node)["properties"][std::to_string(property)];
    std::visit([&place](const auto& content) { place = content; }, value);
    try {
        return document.dump(2) + "\n";
    } catch (const Json::type_error&) { // a text that is not UTF-8
        return {};
    }
}

} // namespace VK::Tree
