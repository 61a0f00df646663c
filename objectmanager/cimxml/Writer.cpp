#include "objectmanager/cimxml/Writer.h"

#include "objectmanager/cimxml/Escape.h"
#include "objectmanager/cimxml/Typing.h"
#include "objectmanager/model/TypeNames.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace cimxml {
namespace {

using Path = std::shared_ptr<const om::ObjectPath>;
using Embedded = std::shared_ptr<const om::Instance>;
using om::elementType;
using om::isArray;

/// Digits enough to read back the same number in its width.
std::string realText(double number, CMPIType type) {
    if (std::isnan(number)) return "NaN";
    if (std::isinf(number)) return number < 0 ? "-INF" : "INF";
    char buffer[40];
    std::snprintf(buffer, sizeof buffer, type == CMPI_real32 ? "%.10e" : "%.16e", number);
    return buffer;
}

/// The character of a UTF-16 unit; half of a pair is none, and is replaced on the way out.
std::string characterText(std::uint64_t unit) {
    std::string text;
    if (unit < 0x80) {
        text += static_cast<char>(unit);
    } else if (unit < 0x800) {
        text += static_cast<char>(0xC0 | (unit >> 6));
        text += static_cast<char>(0x80 | (unit & 0x3F));
    } else {
        text += static_cast<char>(0xE0 | (unit >> 12));
        text += static_cast<char>(0x80 | ((unit >> 6) & 0x3F));
        text += static_cast<char>(0x80 | (unit & 0x3F));
    }
    return unit >= 0xD800 && unit < 0xE000 ? "\xEF\xBF\xBD" : text;
}

std::string scalarText(const om::Value& value) {
    if (const auto* flag = std::get_if<bool>(&value.data)) return *flag ? "TRUE" : "FALSE";
    if (const auto* number = std::get_if<std::uint64_t>(&value.data)) {
        return value.type == CMPI_char16 ? characterText(*number) : std::to_string(*number);
    }
    if (const auto* number = std::get_if<std::int64_t>(&value.data)) return std::to_string(*number);
    if (const auto* number = std::get_if<double>(&value.data)) return realText(*number, value.type);
    if (const auto* text = std::get_if<std::string>(&value.data)) return *text;
    if (const auto* embedded = std::get_if<Embedded>(&value.data); embedded != nullptr && *embedded) {
        Writer inner;
        inner.instance(**embedded);
        return inner.take();
    }
    return {};
}

/// How keys of a type are written, in the words of VALUETYPE.
std::string_view keyKind(CMPIType type) {
    if (type == CMPI_boolean) return "boolean";
    return type == CMPI_string || type == CMPI_dateTime || type == CMPI_char16 ? "string" : "numeric";
}

bool isReference(const om::Value& value) {
    return elementType(value.type) == CMPI_ref;
}

} // namespace

void Writer::attribute(std::string_view name, std::string_view value) {
    out += ' ';
    out += name;
    out += "=\"";
    appendAttribute(out, value);
    out += '"';
}

void Writer::open(std::string_view name, const Attribute* first, const Attribute* end) {
    out += '<';
    out += name;
    for (const Attribute* each = first; each != end; ++each) attribute(each->first, each->second);
    out += '>';
}

void Writer::open(std::string_view name, Attributes list) {
    open(name, list.begin(), list.end());
}

void Writer::open(std::string_view name, const std::vector<Attribute>& list) {
    open(name, list.data(), list.data() + list.size());
}

void Writer::close(std::string_view name) {
    out += "</";
    out += name;
    out += '>';
}

void Writer::empty(std::string_view name, Attributes list) {
    open(name, list);
    close(name);
}

void Writer::leaf(std::string_view name, std::string_view content) {
    open(name);
    appendText(out, content);
    close(name);
}

void Writer::localNameSpace(std::string_view nameSpace) {
    open("LOCALNAMESPACEPATH");
    for (std::size_t at = 0; at <= nameSpace.size();) {
        const std::size_t end = std::min(nameSpace.find('/', at), nameSpace.size());
        empty("NAMESPACE", {{"NAME", nameSpace.substr(at, end - at)}});
        at = end + 1;
    }
    close("LOCALNAMESPACEPATH");
}

void Writer::nameSpacePath(std::string_view host, std::string_view nameSpace) {
    open("NAMESPACEPATH");
    leaf("HOST", host);
    localNameSpace(nameSpace);
    close("NAMESPACEPATH");
}

void Writer::classPath(std::string_view host, std::string_view nameSpace, std::string_view name) {
    open("CLASSPATH");
    nameSpacePath(host, nameSpace);
    className(name);
    close("CLASSPATH");
}

void Writer::key(const om::NamedValue& key) {
    open("KEYBINDING", {{"NAME", key.first}});
    if (isReference(key.second)) {
        value(key.second);
    } else {
        open("KEYVALUE", {{"VALUETYPE", keyKind(key.second.type)}, {"TYPE", typeName(key.second.type)}});
        appendText(out, scalarText(key.second));
        close("KEYVALUE");
    }
    close("KEYBINDING");
}

void Writer::instanceName(const om::ObjectPath& path) {
    open("INSTANCENAME", {{"CLASSNAME", path.className}});
    for (const om::NamedValue& each : path.keys) {
        if (!each.second.isNull()) key(each);
    }
    close("INSTANCENAME");
}

void Writer::localInstancePath(const om::ObjectPath& path) {
    open("LOCALINSTANCEPATH");
    localNameSpace(path.nameSpace);
    instanceName(path);
    close("LOCALINSTANCEPATH");
}

void Writer::instancePath(const om::ObjectPath& path, std::string_view host) {
    open("INSTANCEPATH");
    nameSpacePath(host, path.nameSpace);
    instanceName(path);
    close("INSTANCEPATH");
}

void Writer::scalar(const om::Value& value) {
    if (value.isNull()) {
        empty("VALUE.NULL");
    } else if (const auto* path = std::get_if<Path>(&value.data)) {
        open("VALUE.REFERENCE");
        if ((*path)->nameSpace.empty()) {
            instanceName(**path);
        } else {
            localInstancePath(**path);
        }
        close("VALUE.REFERENCE");
    } else {
        leaf("VALUE", scalarText(value));
    }
}

void Writer::value(const om::Value& value) {
    if (value.isNull()) return;
    const auto* elements = std::get_if<std::vector<om::Value>>(&value.data);
    if (elements == nullptr) {
        scalar(value);
        return;
    }
    const char* const name = isReference(value) ? "VALUE.REFARRAY" : "VALUE.ARRAY";
    open(name);
    for (const om::Value& element : *elements) scalar(element);
    close(name);
}

void Writer::property(const std::string& name, const om::Value& value, const Origin& origin) {
    const bool reference = isReference(value);
    if (reference && isArray(value.type)) return; // no property is an array of references
    const char* const element = reference ? "PROPERTY.REFERENCE" : isArray(value.type) ? "PROPERTY.ARRAY" : "PROPERTY";
    out += '<';
    out += element;
    attribute("NAME", name);
    if (!reference) attribute("TYPE", typeName(value.type));
    if (elementType(value.type) == CMPI_instance) attribute("EmbeddedObject", "instance");
    if (const auto* path = std::get_if<Path>(&value.data)) attribute("REFERENCECLASS", (*path)->className);
    if (origin) attribute("CLASSORIGIN", origin(name));
    out += '>';
    this->value(value);
    close(element);
}

void Writer::instance(const om::Instance& instance, const Origin& origin) {
    open("INSTANCE", {{"CLASSNAME", instance.path.className}});
    for (const auto& [name, value] : instance.properties) property(name, value, origin);
    close("INSTANCE");
}

void Writer::intrinsicParameter(std::string_view name, const om::Value& value) {
    open("IPARAMVALUE", {{"NAME", name}});
    this->value(value);
    close("IPARAMVALUE");
}

void Writer::typedAttributes(const om::Value& value) {
    attribute("PARAMTYPE", typeName(value.type));
    if (elementType(value.type) == CMPI_instance) attribute("EmbeddedObject", "instance");
    out += '>';
}

void Writer::parameter(std::string_view name, const om::Value& value) {
    out += "<PARAMVALUE";
    attribute("NAME", name);
    typedAttributes(value);
    this->value(value);
    close("PARAMVALUE");
}

void Writer::returnValue(const om::Value& value) {
    out += "<RETURNVALUE";
    typedAttributes(value);
    this->value(value);
    close("RETURNVALUE");
}

} // namespace cimxml
