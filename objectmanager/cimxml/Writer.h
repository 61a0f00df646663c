#pragma once

#include "objectmanager/model/Values.h"

#include <functional>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace cimxml {

/// Where a property was declared first; empty where CLASSORIGIN is not written.
using Origin = std::function<std::string_view(const std::string& property)>;

/// Writes elements one after the other. An empty element is a pair of tags, since some clients read no other form of
/// it.
class Writer {
public:
    using Attribute = std::pair<std::string_view, std::string_view>;
    using Attributes = std::initializer_list<Attribute>;

    Writer() = default;
    /// Writes behind what is there, and into the room that it has.
    explicit Writer(std::string begun) : out(std::move(begun)) {}

    const std::string& text() const { return out; }
    std::string take() { return std::move(out); }

    void open(std::string_view name, Attributes attributes = {});
    void open(std::string_view name, const std::vector<Attribute>& attributes);
    void close(std::string_view name);
    void empty(std::string_view name, Attributes attributes = {});
    void leaf(std::string_view name, std::string_view content);
    /// What was written before.
    void raw(std::string_view elements) { out += elements; }

    void className(std::string_view name) { empty("CLASSNAME", {{"NAME", name}}); }
    void localNameSpace(std::string_view nameSpace);
    /// HOST and LOCALNAMESPACEPATH.
    void nameSpacePath(std::string_view host, std::string_view nameSpace);
    void classPath(std::string_view host, std::string_view nameSpace, std::string_view name);
    void instanceName(const om::ObjectPath& path);
    void localInstancePath(const om::ObjectPath& path);
    void instancePath(const om::ObjectPath& path, std::string_view host);

    /// VALUE, VALUE.ARRAY, VALUE.REFERENCE or VALUE.REFARRAY; nothing for null.
    void value(const om::Value& value);
    void property(const std::string& name, const om::Value& value, const Origin& origin = {});
    void instance(const om::Instance& instance, const Origin& origin = {});
    /// IPARAMVALUE of an intrinsic operation, or PARAMVALUE with its PARAMTYPE.
    void intrinsicParameter(std::string_view name, const om::Value& value);
    void parameter(std::string_view name, const om::Value& value);
    void returnValue(const om::Value& value);

private:
    void open(std::string_view name, const Attribute* first, const Attribute* end);
    void attribute(std::string_view name, std::string_view value);
    void key(const om::NamedValue& key);
    void scalar(const om::Value& value);
    void typedAttributes(const om::Value& value);

    std::string out;
};

} // namespace cimxml
