#include "objectmanager/vkcim/PathText.h"

#include "objectmanager/model/Characters.h"
#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/ParseError.h"
#include "objectmanager/vkcim/Suggestion.h"

#include <fmt/format.h>

#include <algorithm>

namespace vkcim {
namespace {

std::string shown(char c) {
    return c > ' ' && c < 0x7f ? fmt::format("'{}'", c) : fmt::format("byte 0x{:02x}", static_cast<unsigned char>(c));
}

bool isNameSpaceByte(char c) {
    return om::isNameByte(c) || c == '/' || c == '-';
}

/// The kind of key that a type is written as in a path: all integers are one.
const char* kindOf(CMPIType type) {
    switch (type) {
    case CMPI_boolean:
        return "TRUE or FALSE";
    case CMPI_ref:
        return "a path in quotes";
    case CMPI_string:
    case CMPI_chars:
    case CMPI_dateTime:
    case CMPI_real32:
    case CMPI_real64:
        return "text in quotes";
    default:
        return "a number";
    }
}

class PathParser {
public:
    PathParser(const SourceText& source, const std::string& nameSpace, const om::Schema& knownClasses,
               std::vector<std::string>* remarksOut)
        : text(source), schema(knownClasses), remarks(remarksOut) {
        path.nameSpace = nameSpace;
    }

    om::ObjectPath parse() {
        if (text.size() == 0) fail(0, "the path is empty");
        readNameSpace();
        path.className = readName("class name");
        if (atEnd()) return path;
        if (text[at] != '.') fail(at, "unexpected " + shown(text[at]) + " after the class name (keys follow a '.')");
        do {
            ++at;
            readKey();
            if (!atEnd() && text[at] != ',') fail(at, "unexpected " + shown(text[at]) + " after a key's value");
        } while (!atEnd());
        return path;
    }

private:
    [[noreturn]] void fail(std::size_t index, const std::string& what) const {
        throw ParseError(text.offsetOf(index), what);
    }

    bool atEnd() const { return at == text.size(); }

    void readNameSpace() {
        std::size_t colon = 0;
        while (colon < text.size() && isNameSpaceByte(text[colon])) ++colon;
        if (colon == text.size() || text[colon] != ':') return;
        const std::string_view name = text.text().substr(0, colon);
        if (name.empty()) fail(0, "the namespace before ':' is empty");
        if (name.substr(0, 2) == "//") fail(0, "a path here names no host");
        if (const auto problem = nameSpaceProblem(name)) fail(0, *problem);
        path.nameSpace = name;
        at = colon + 1;
    }

    std::string readName(const char* what) {
        const std::size_t first = at;
        if (atEnd()) fail(at, fmt::format("a {} is missing", what));
        if (!om::isNameStart(text[at])) fail(at, fmt::format("a {} cannot start with {}", what, shown(text[at])));
        while (!atEnd() && om::isNameByte(text[at])) ++at;
        return std::string(text.text().substr(first, at - first));
    }

    void readKey() {
        const std::size_t first = at;
        const std::string name = readName("key name");
        for (const om::NamedValue& known : path.keys) {
            if (om::sameName(known.first, name)) fail(first, fmt::format("key {} is given twice", name));
        }
        if (atEnd() || text[at] != '=') fail(at, fmt::format("'=' is missing after key {}", name));
        ++at;
        if (atEnd() || text[at] == ',') fail(at, fmt::format("key {} has no value", name));
        const std::size_t value = at;
        path.keys.emplace_back(name, readValue(name));
        const om::ResolvedClass* known = remarks != nullptr ? schema.resolve(path.className) : nullptr;
        if (known != nullptr && !known->keys.empty()) check(*known, path.keys.back(), first, value);
    }

    void check(const om::ResolvedClass& known, const om::NamedValue& key, std::size_t first, std::size_t value) {
        const om::PropertyDeclaration* declared = known.findProperty(key.first);
        std::string remark;
        if (declared == nullptr || !declared->key) {
            std::vector<std::string> keys;
            for (const om::PropertyDeclaration* each : known.keys) keys.push_back(each->name);
            const auto nearest = nearestName(key.first, keys);
            remark = fmt::format("{} has no key {}{}", known.declaration->name, key.first,
                                 nearest ? didYouMean(nearest) : fmt::format("; its keys: {}", fmt::join(keys, ", ")));
        } else if (std::string_view(kindOf(declared->type)) != kindOf(key.second.type)) {
            first = value;
            remark = fmt::format("key {} of {} is {}", declared->name, known.declaration->name, kindOf(declared->type));
        }
        if (!remark.empty()) remarks->push_back(ParseError(text.offsetOf(first), remark).what());
    }

    om::Value readValue(const std::string& key) {
        constexpr std::string_view reference = "ref:\"";
        if (text.text().substr(at, reference.size()) == reference) {
            at += reference.size() - 1;
            return referenceTo(readQuoted());
        }
        if (text[at] != '"') return readBare(key);
        const SourceText quoted = readQuoted();
        const om::PropertyDeclaration* declared = schema.findProperty(path.className, key);
        if (declared && declared->type == CMPI_ref) return referenceTo(quoted);
        return {CMPI_string, std::string(quoted.text())};
    }

    om::Value referenceTo(const SourceText& quoted) const {
        return {CMPI_ref, std::make_shared<const om::ObjectPath>(parsePath(quoted, path.nameSpace, schema, remarks))};
    }

    SourceText readQuoted() {
        const std::size_t opening = at++;
        SourceText inside;
        for (; !atEnd() && text[at] != '"'; ++at) {
            const std::size_t offset = text.offsetOf(at);
            if (text[at] == '\\') {
                ++at;
                if (atEnd()) break;
                if (text[at] != '"' && text[at] != '\\') {
                    fail(at, fmt::format("{} after '\\' (only \\\" and \\\\ are escapes)", shown(text[at])));
                }
            }
            inside.append(text[at], offset);
        }
        if (atEnd()) fail(opening, "the quote is not closed");
        inside.end(text.offsetOf(at++));
        return inside;
    }

    om::Value readBare(const std::string& key) {
        const std::size_t first = at;
        while (!atEnd() && text[at] != ',') ++at;
        const std::string_view word = text.text().substr(first, at - first);
        if (om::sameName(word, "TRUE")) return {CMPI_boolean, true};
        if (om::sameName(word, "FALSE")) return {CMPI_boolean, false};
        if (!om::looksLikeInteger(word)) {
            fail(first, fmt::format("the value of key {} is no quoted text, integer, TRUE or FALSE", key));
        }
        om::Value value;
        if (om::readNumber(word, CMPI_sint64, value) == om::NumberError::None) return value;
        if (om::readNumber(word, CMPI_uint64, value) == om::NumberError::None) return value;
        fail(first, fmt::format("{} is out of range ({} as sint64, up to 18446744073709551615 as uint64)", word,
                                om::rangeOf(CMPI_sint64)));
    }

    const SourceText& text;
    const om::Schema& schema;
    std::vector<std::string>* const remarks;
    std::size_t at = 0;
    om::ObjectPath path;
};

std::string keyInQuotes(std::string_view text) {
    std::string result = "\"";
    for (const char c : text) {
        if (c == '"' || c == '\\') result += '\\';
        result += c;
    }
    return result + '"';
}

std::string keyText(const om::ObjectPath& path, const om::NamedValue& key, const std::string& nameSpace,
                    const om::Schema& schema) {
    const om::Value& value = key.second;
    if (const auto* flag = std::get_if<bool>(&value.data)) return *flag ? "TRUE" : "FALSE";
    if (const auto* text = std::get_if<std::string>(&value.data)) return keyInQuotes(*text);
    if (const auto* reference = std::get_if<std::shared_ptr<const om::ObjectPath>>(&value.data);
        reference && *reference) {
        const om::PropertyDeclaration* declared = schema.findProperty(path.className, key.first);
        const char* prefix = declared && declared->type == CMPI_ref ? "" : "ref:";
        return prefix + keyInQuotes(qualifiedPathText(**reference, nameSpace, schema));
    }
    if (std::holds_alternative<double>(value.data)) return keyInQuotes(om::numberText(value));
    const std::string number = om::numberText(value);
    return number.empty() ? "NULL" : number;
}

} // namespace

std::optional<std::string> nameSpaceProblem(std::string_view name) {
    if (name.empty()) return "the namespace is empty";
    const auto* bad = std::find_if_not(name.begin(), name.end(), isNameSpaceByte);
    if (bad != name.end()) return fmt::format("a namespace cannot hold {}", shown(*bad));
    if (name.front() == '/' || name.back() == '/' || name.find("//") != std::string_view::npos) {
        return fmt::format("namespace \"{}\" has an empty part", name);
    }
    return std::nullopt;
}

om::ObjectPath parsePath(const SourceText& text, const std::string& nameSpace, const om::Schema& schema,
                         std::vector<std::string>* remarks) {
    return PathParser(text, nameSpace, schema, remarks).parse();
}

om::ObjectPath parsePath(std::string_view text, const std::string& nameSpace, const om::Schema& schema,
                         std::vector<std::string>* remarks) {
    return parsePath(SourceText(text), nameSpace, schema, remarks);
}

std::string pathText(const om::ObjectPath& path, const std::string& nameSpace, const om::Schema& schema) {
    std::string result = path.className;
    char separator = '.';
    for (const om::NamedValue& key : path.keys) {
        result += separator + key.first + '=' + keyText(path, key, nameSpace, schema);
        separator = ',';
    }
    return result;
}

std::string qualifiedPathText(const om::ObjectPath& path, const std::string& nameSpace, const om::Schema& schema) {
    if (path.nameSpace.empty() || path.nameSpace == nameSpace) return pathText(path, nameSpace, schema);
    // A reference inside inherits the namespace written here.
    return path.nameSpace + ':' + pathText(path, path.nameSpace, schema);
}

} // namespace vkcim
