#include "objectmanager/broker/Describe.h"

#include <type_traits>

namespace om {

namespace {

std::string quoted(const std::string& text) {
    std::string result = "\"";
    for (const char c : text) {
        if (c == '"' || c == '\\') result += '\\';
        result += c;
    }
    return result + '"';
}

std::string join(const std::vector<NamedValue>& list) {
    std::string result;
    for (const auto& [name, value] : list) {
        if (!result.empty()) result += ',';
        result += name + '=' + describe(value);
    }
    return result;
}

struct Describer {
    std::string operator()(std::monostate) const { return "NULL"; }
    std::string operator()(bool value) const { return value ? "TRUE" : "FALSE"; }
    std::string operator()(const std::string& value) const { return quoted(value); }
    std::string operator()(const std::shared_ptr<const ObjectPath>& value) const { return quoted(describe(*value)); }
    std::string operator()(const std::shared_ptr<const Instance>& value) const { return describe(*value); }
    std::string operator()(const std::vector<Value>& values) const {
        std::string result;
        for (const Value& value : values) result += (result.empty() ? "" : ", ") + describe(value);
        return '{' + result + '}';
    }
    template <class Number>
    std::enable_if_t<std::is_arithmetic_v<Number>, std::string> operator()(Number value) const {
        return std::to_string(value);
    }
};

} // namespace

std::string describe(const Value& value) {
    return std::visit(Describer(), value.data);
}

std::string describe(const ObjectPath& path) {
    std::string result = path.host.empty() ? "" : "//" + path.host + '/';
    if (!path.nameSpace.empty()) result += path.nameSpace + ':';
    result += path.className;
    return path.keys.empty() ? result : result + '.' + join(path.keys);
}

std::string describe(const std::vector<NamedValue>& list) {
    return '{' + join(list) + '}';
}

std::string describe(const Instance& instance) {
    return describe(instance.path) + ' ' + describe(instance.properties);
}

} // namespace om
