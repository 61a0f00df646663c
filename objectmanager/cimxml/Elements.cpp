#include "objectmanager/cimxml/Elements.h"

#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Errors.h"

#include <algorithm>

namespace cimxml {
namespace {

constexpr std::string_view blanks = " \t\r\n";

bool isText(const pugi::xml_node& node) {
    return node.type() == pugi::node_pcdata || node.type() == pugi::node_cdata;
}

bool named(const pugi::xml_node& node, std::string_view name) {
    return name == node.name();
}

[[noreturn]] void unexpected(const pugi::xml_node& node, const pugi::xml_node& parent) {
    throw notValid(std::string("element ") + node.name() + " in " + parent.name());
}

template <class T>
std::shared_ptr<const T> shared(T value) {
    return std::make_shared<const T>(std::move(value));
}

/// The first element among a node and its siblings; none where there is none left. Throws where text stands before it.
pugi::xml_node elementFrom(pugi::xml_node node) {
    for (; node && node.type() != pugi::node_element; node = node.next_sibling()) {
        if (isText(node) && std::string_view(node.value()).find_first_not_of(blanks) != std::string_view::npos) {
            throw notValid(std::string("text in element ") + node.parent().name());
        }
    }
    return node;
}

void expectEmpty(const pugi::xml_node& node) {
    if (elementFrom(node.first_child())) throw notValid(std::string("element ") + node.name() + " is empty");
}

/// Two children of these kinds, in this order.
std::pair<pugi::xml_node, pugi::xml_node> pairOf(const pugi::xml_node& node, std::string_view first) {
    const std::vector<pugi::xml_node> children = childElements(node);
    if (children.size() != 2 || !named(children[0], first)) {
        throw notValid(std::string("element ") + node.name() + " lacks a part");
    }
    return {children[0], children[1]};
}

ValueElement elementsOf(const pugi::xml_node& node, ValueElement::Kind kind, std::string_view element) {
    checkAttributes(node, {});
    ValueElement value;
    value.kind = kind;
    for (const pugi::xml_node& child : childElements(node)) {
        if (named(child, "VALUE.NULL")) {
            expectEmpty(child);
            value.elements.emplace_back();
        } else if (named(child, element)) {
            value.elements.push_back(readValue(child));
        } else {
            unexpected(child, node);
        }
    }
    return value;
}

ValueElement pathValue(ValueElement::Kind kind, const pugi::xml_node& path) {
    ValueElement value;
    value.kind = kind;
    value.path = shared(readPath(path));
    return value;
}

KeyElement readKeyValue(const pugi::xml_node& node) {
    KeyElement key;
    if (named(node, "VALUE.REFERENCE")) {
        key.value = readValue(node);
        return key;
    }
    if (!named(node, "KEYVALUE")) unexpected(node, node.parent());
    checkAttributes(node, {"VALUETYPE", "TYPE"});
    key.valueType = node.attribute("VALUETYPE").as_string("string");
    if (key.valueType != "string" && key.valueType != "numeric" && key.valueType != "boolean") {
        throw notValid("VALUETYPE " + key.valueType);
    }
    key.type = node.attribute("TYPE").as_string();
    key.value.kind = ValueElement::Kind::Text;
    key.value.text = textOf(node);
    return key;
}

void readKeys(const pugi::xml_node& node, PathElement& path) {
    const std::vector<pugi::xml_node> children = childElements(node);
    if (children.size() == 1 && !named(children[0], "KEYBINDING")) {
        path.keys.push_back(readKeyValue(children[0]));
        return;
    }
    for (const pugi::xml_node& child : children) {
        if (!named(child, "KEYBINDING")) unexpected(child, node);
        checkAttributes(child, {"NAME"});
        KeyElement key = readKeyValue(onlyChild(child));
        key.name = required(child, "NAME");
        path.keys.push_back(std::move(key));
    }
}

PropertyElement readProperty(const pugi::xml_node& node) {
    PropertyElement property;
    checkAttributes(node, {"NAME", "TYPE", "ARRAYSIZE", "REFERENCECLASS", "CLASSORIGIN", "PROPAGATED", "EmbeddedObject",
                           "EMBEDDEDOBJECT", "xml:lang"});
    property.name = required(node, "NAME");
    const bool reference = named(node, "PROPERTY.REFERENCE");
    if (!reference) property.type = required(node, "TYPE");
    property.array = named(node, "PROPERTY.ARRAY");
    property.embedded = node.attribute("EmbeddedObject") || node.attribute("EMBEDDEDOBJECT");
    const std::string_view expected = property.array ? "VALUE.ARRAY" : reference ? "VALUE.REFERENCE" : "VALUE";
    bool valued = false;
    for (const pugi::xml_node& child : childElements(node)) {
        if (named(child, "QUALIFIER") && !valued) continue;
        if (!named(child, expected) || valued) unexpected(child, node);
        property.value = readValue(child);
        valued = true;
    }
    return property;
}

} // namespace

std::vector<pugi::xml_node> childElements(const pugi::xml_node& node) {
    std::vector<pugi::xml_node> found;
    for (pugi::xml_node child = elementFrom(node.first_child()); child; child = elementFrom(child.next_sibling())) {
        found.push_back(child);
    }
    return found;
}

pugi::xml_node onlyChild(const pugi::xml_node& node) {
    const pugi::xml_node child = elementFrom(node.first_child());
    if (!child || elementFrom(child.next_sibling())) {
        throw notValid(std::string("element ") + node.name() + " holds one element");
    }
    return child;
}

void checkAttributes(const pugi::xml_node& node, std::initializer_list<std::string_view> allowed) {
    for (const pugi::xml_attribute& attribute : node.attributes()) {
        const std::string_view name = attribute.name();
        if (node.attribute(attribute.name()) != attribute) {
            throw notWellFormed(std::string("attribute ") + attribute.name() + " stands twice in " + node.name());
        }
        if (std::find(allowed.begin(), allowed.end(), name) == allowed.end()) {
            throw notValid(std::string("attribute ") + attribute.name() + " of " + node.name());
        }
    }
}

std::string required(const pugi::xml_node& node, const char* attribute) {
    const pugi::xml_attribute found = node.attribute(attribute);
    if (!found) throw notValid(std::string("element ") + node.name() + " lacks " + attribute);
    return found.value();
}

std::string textOf(const pugi::xml_node& node) {
    std::string text;
    for (const pugi::xml_node& child : node) {
        if (isText(child)) {
            text += child.value();
        } else if (child.type() == pugi::node_element) {
            unexpected(child, node);
        }
    }
    return text;
}

bool isValueElement(std::string_view name) {
    static constexpr std::string_view names[] = {
        "VALUE",        "VALUE.ARRAY", "VALUE.REFERENCE",     "VALUE.REFARRAY",        "CLASSNAME",
        "INSTANCENAME", "INSTANCE",    "VALUE.NAMEDINSTANCE", "QUALIFIER.DECLARATION", "CLASS"};
    return std::find(std::begin(names), std::end(names), name) != std::end(names);
}

ValueElement readValue(const pugi::xml_node& node) {
    using Kind = ValueElement::Kind;
    ValueElement value;
    if (named(node, "VALUE")) {
        checkAttributes(node, {});
        value.kind = Kind::Text;
        value.text = textOf(node);
    } else if (named(node, "VALUE.ARRAY")) {
        value = elementsOf(node, Kind::Array, "VALUE");
    } else if (named(node, "VALUE.REFARRAY")) {
        value = elementsOf(node, Kind::References, "VALUE.REFERENCE");
    } else if (named(node, "VALUE.REFERENCE")) {
        checkAttributes(node, {});
        value = pathValue(Kind::Reference, onlyChild(node));
    } else if (named(node, "CLASSNAME")) {
        value = pathValue(Kind::ClassName, node);
    } else if (named(node, "INSTANCENAME")) {
        value = pathValue(Kind::InstanceName, node);
    } else if (named(node, "INSTANCE")) {
        value.kind = Kind::Instance;
        value.instance = shared(readInstance(node));
    } else if (named(node, "VALUE.NAMEDINSTANCE")) {
        checkAttributes(node, {});
        const auto [name, instance] = pairOf(node, "INSTANCENAME");
        value = pathValue(Kind::NamedInstance, name);
        value.instance = shared(readInstance(instance));
    } else {
        value.kind = Kind::Other;
    }
    return value;
}

std::string readLocalNameSpace(const pugi::xml_node& node) {
    if (!named(node, "LOCALNAMESPACEPATH")) unexpected(node, node.parent());
    checkAttributes(node, {});
    std::string joined;
    for (const pugi::xml_node& child : childElements(node)) {
        if (!named(child, "NAMESPACE")) unexpected(child, node);
        checkAttributes(child, {"NAME"});
        expectEmpty(child);
        const std::string name = required(child, "NAME");
        if (name.empty() || name.find('/') != std::string::npos) throw notValid("a namespace's name is one component");
        joined += (joined.empty() ? "" : "/") + name;
    }
    if (joined.empty()) throw notValid("a namespace path without a namespace");
    return joined;
}

PathElement readPath(const pugi::xml_node& node) {
    PathElement path;
    if (named(node, "CLASSNAME")) {
        checkAttributes(node, {"NAME"});
        expectEmpty(node);
        path.className = required(node, "NAME");
    } else if (named(node, "INSTANCENAME")) {
        checkAttributes(node, {"CLASSNAME"});
        path.instance = true;
        path.className = required(node, "CLASSNAME");
        readKeys(node, path);
    } else if (named(node, "LOCALCLASSPATH") || named(node, "LOCALINSTANCEPATH")) {
        checkAttributes(node, {});
        const auto [space, inner] = pairOf(node, "LOCALNAMESPACEPATH");
        if (!named(inner, named(node, "LOCALCLASSPATH") ? "CLASSNAME" : "INSTANCENAME")) unexpected(inner, node);
        path = readPath(inner);
        path.nameSpace = readLocalNameSpace(space);
    } else if (named(node, "CLASSPATH") || named(node, "INSTANCEPATH")) {
        checkAttributes(node, {});
        const auto [space, inner] = pairOf(node, "NAMESPACEPATH");
        if (!named(inner, named(node, "CLASSPATH") ? "CLASSNAME" : "INSTANCENAME")) unexpected(inner, node);
        checkAttributes(space, {});
        const auto [host, local] = pairOf(space, "HOST");
        path = readPath(inner);
        path.host = textOf(host);
        path.nameSpace = readLocalNameSpace(local);
    } else {
        unexpected(node, node.parent());
    }
    if (path.className.empty()) throw notValid("a class without a name");
    return path;
}

InstanceElement readInstance(const pugi::xml_node& node) {
    if (!named(node, "INSTANCE")) unexpected(node, node.parent());
    checkAttributes(node, {"CLASSNAME", "xml:lang"});
    InstanceElement instance;
    instance.className = required(node, "CLASSNAME");
    for (const pugi::xml_node& child : childElements(node)) {
        if (named(child, "QUALIFIER") && instance.properties.empty()) continue;
        if (!named(child, "PROPERTY") && !named(child, "PROPERTY.ARRAY") && !named(child, "PROPERTY.REFERENCE")) {
            unexpected(child, node);
        }
        instance.properties.push_back(readProperty(child));
    }
    return instance;
}

InstanceElement readEmbedded(std::string_view text) {
    pugi::xml_document document;
    load(document, text, mostElements);
    return readInstance(document.document_element());
}

} // namespace cimxml
