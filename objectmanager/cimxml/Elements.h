#pragma once

#include <pugixml.hpp>

#include <memory>
#include <string>
#include <string_view>
#include <vector>

/// Elements as they stand in a message: checked against the DTD, their texts without a type yet.
namespace cimxml {

struct PathElement;
struct InstanceElement;

/// VALUE and its kin, and what else a parameter may hold.
struct ValueElement {
    enum class Kind {
        None, ///< no value: null
        Text,
        Array,     ///< elements are Text or None
        Reference, ///< `path`
        References,
        ClassName,     ///< `path`, without keys
        InstanceName,  ///< `path`
        Instance,      ///< `instance`
        NamedInstance, ///< `path` and `instance`
        Other          ///< a declaration, which nothing here reads
    };

    Kind kind = Kind::None;
    std::string text;
    std::vector<ValueElement> elements;
    std::shared_ptr<const PathElement> path;
    std::shared_ptr<const InstanceElement> instance;
};

struct KeyElement {
    std::string name; ///< empty for the single key of a class that has one
    std::string valueType;
    std::string type;   ///< empty where the message has none
    ValueElement value; ///< Text or Reference
};

struct PathElement {
    bool instance = false; ///< or of a class
    std::string host;
    std::string nameSpace; ///< empty where the message has none
    std::string className;
    std::vector<KeyElement> keys;
};

struct PropertyElement {
    std::string name;
    std::string type; ///< empty for references
    bool array = false;
    bool embedded = false; ///< a string that holds an instance
    ValueElement value;
};

struct InstanceElement {
    std::string className;
    std::vector<PropertyElement> properties;
};

/// The element children of a node. Throws Refusal where text stands between them.
std::vector<pugi::xml_node> childElements(const pugi::xml_node& node);
/// The only element child. Throws Refusal where there is none, or more.
pugi::xml_node onlyChild(const pugi::xml_node& node);
/// Throws Refusal for an attribute that stands twice or that the element does not have.
void checkAttributes(const pugi::xml_node& node, std::initializer_list<std::string_view> allowed);
/// An attribute's text. Throws Refusal where it is missing.
std::string required(const pugi::xml_node& node, const char* attribute);
/// The text of an element without children. Throws Refusal where it has some.
std::string textOf(const pugi::xml_node& node);

/// Whether values of that element's name can be read with readValue.
bool isValueElement(std::string_view name);
/// All of these throw Refusal for what the DTD does not allow.
ValueElement readValue(const pugi::xml_node& node);
/// LOCALNAMESPACEPATH, as its components with slashes between them.
std::string readLocalNameSpace(const pugi::xml_node& node);
/// INSTANCENAME, CLASSNAME and the paths around them.
PathElement readPath(const pugi::xml_node& node);
InstanceElement readInstance(const pugi::xml_node& node);
/// The instance in the text of a VALUE. Throws Refusal.
InstanceElement readEmbedded(std::string_view text);

} // namespace cimxml
