#include "tree/TreeReader.h"

#include "common/Text.h"
#include "logger/LogLine.h"

#include <limits>

namespace VK::Tree {

namespace {

constexpr std::uint64_t LARGEST = std::numeric_limits<unsigned int>::max();

/// A whole number in decimal as people write it: no sign, no needless zeros.
bool parseNumber(const std::string& text, unsigned int& number) {
    if (text.empty() || text.size() > 10 || text.find_first_not_of("0123456789") != std::string::npos) return false;
    if (text.size() > 1 && text.front() == '0') return false;
    const unsigned long long value = std::stoull(text);
    if (value > LARGEST) return false;
    number = static_cast<unsigned int>(value);
    return true;
}

} // namespace

bool TreeReader::refuse(const std::string& what) {
    result.problem = what + " at byte " + std::to_string(position);
    return false;
}

bool TreeReader::misplaced(const std::string& kind) {
    return refuse(kind + " where it does not belong");
}

bool TreeReader::null() {
    return misplaced("null");
}

bool TreeReader::boolean(bool value) {
    if (where != Product || current != KvmKey) return misplaced("true or false");
    result.product.kvm = value;
    return true;
}

bool TreeReader::number_integer(std::int64_t value) {
    return refuse("negative number " + std::to_string(value));
}

bool TreeReader::number_float(double, const std::string& text) {
    return refuse("number " + inQuotes(text) + " is not a whole one or too large");
}

bool TreeReader::number_unsigned(std::uint64_t value) {
    if (value > LARGEST) return refuse("number " + std::to_string(value) + " is too large");
    const auto number = static_cast<unsigned int>(value);
    if (where == Properties) {
        node.properties[property] = number;
        return true;
    }
    if (where == Numbers) {
        numbers().push_back(number);
        return true;
    }
    if (where == OneNode && (current == TypeKey || current == StatusKey)) {
        (current == TypeKey ? node.type : node.status) = number;
        return true;
    }
    return misplaced("number");
}

bool TreeReader::string(std::string& text) {
    if (hasZeroByte(text)) return refuse("text with a zero byte");
    if (where == Properties) {
        node.properties[property] = text;
        return true;
    }
    switch (where == Product || where == OneNode ? current : NodesKey) {
    case ArchitectureKey:
        result.product.architecture = text;
        return true;
    case UidKey:
        result.product.uid = text;
        return true;
    case RootDirectoryKey:
        result.product.rootDirectory = text;
        return true;
    case ParentKey:
        node.parent = text;
        return true;
    case DescriptionKey:
        node.description = text;
        return true;
    case PathKey:
        if (text.empty()) return refuse("empty path");
        if (!paths.insert(text).second) return refuse("path " + inQuotes(text) + " is given twice");
        node.path = text;
        return true;
    default:
        return misplaced("text");
    }
}

bool TreeReader::binary(nlohmann::json::binary_t&) {
    return misplaced("binary value");
}

bool TreeReader::start_object(std::size_t) {
    if (where == Outside) {
        where = Top;
    } else if (where == Top && current == ProductKey) {
        where = Product;
        seenTop = seen;
    } else if (where == AllNodes) {
        where = OneNode;
        node = Node();
    } else if (where == OneNode && current == PropertiesKey) {
        where = Properties;
        return true;
    } else {
        return misplaced("object");
    }
    seen = 0;
    return true;
}

bool TreeReader::end_object() {
    switch (where) {
    case Properties:
        where = OneNode;
        return true;
    case OneNode:
        return finishNode();
    case Product:
        where = Top;
        seen = seenTop;
        return true;
    default:
        where = Done;
        return has(NodesKey) || refuse("no \"nodes\"");
    }
}

bool TreeReader::start_array(std::size_t) {
    if (where == Top && current == NodesKey) {
        where = AllNodes;
        seenTop = seen;
        return true;
    }
    if (where == OneNode && current >= ReadOnlyKey && current <= FailWritesKey) {
        where = Numbers;
        return true;
    }
    return misplaced("array");
}

bool TreeReader::end_array() {
    if (where == AllNodes) seen = seenTop;
    where = where == AllNodes ? Top : OneNode;
    return true;
}

bool TreeReader::key(std::string& name) {
    return where == Properties ? takePropertyNumber(name) : takeKey(name);
}

bool TreeReader::takeKey(const std::string& name) {
    struct Known {
        Where where;
        const char* name;
        Key key;
    };
    static constexpr Known KNOWN[] = {
        {Top, "product", ProductKey},
        {Top, "nodes", NodesKey},
        {Product, "architecture", ArchitectureKey},
        {Product, "uid", UidKey},
        {Product, "rootDirectory", RootDirectoryKey},
        {Product, "kvm", KvmKey},
        {OneNode, "type", TypeKey},
        {OneNode, "path", PathKey},
        {OneNode, "parent", ParentKey},
        {OneNode, "status", StatusKey},
        {OneNode, "description", DescriptionKey},
        {OneNode, "properties", PropertiesKey},
        {OneNode, "readOnly", ReadOnlyKey},
        {OneNode, "unanswerable", UnanswerableKey},
        {OneNode, "failWrites", FailWritesKey},
    };
    for (const Known& known : KNOWN) {
        if (known.where != where || name != known.name) continue;
        if (has(known.key)) return refuse("key " + inQuotes(name) + " is given twice");
        seen |= 1U << known.key;
        current = known.key;
        return true;
    }
    return refuse("unknown key " + inQuotes(name));
}

bool TreeReader::takePropertyNumber(const std::string& text) {
    if (!parseNumber(text, property)) return refuse("property " + inQuotes(text) + " is not a number in decimal");
    if (node.properties.count(property) != 0) return refuse("property " + inQuotes(text) + " is given twice");
    return true;
}

bool TreeReader::finishNode() {
    if (!has(TypeKey)) return refuse("node without \"type\"");
    if (!has(PathKey)) return refuse("node without \"path\"");
    result.nodes.push_back(std::move(node));
    where = AllNodes;
    return true;
}

std::vector<unsigned int>& TreeReader::numbers() {
    switch (current) {
    case ReadOnlyKey:
        return node.readOnly;
    case UnanswerableKey:
        return node.unanswerable;
    default:
        return node.failWrites;
    }
}

bool TreeReader::parse_error(std::size_t at, const std::string& lastToken, const nlohmann::json::exception&) {
    if (result.problem.empty())
        result.problem = "not JSON at byte " + std::to_string(at) + ", near " + inQuotes(lastToken);
    return false;
}

} // namespace VK::Tree
