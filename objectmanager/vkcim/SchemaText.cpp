#include "objectmanager/vkcim/SchemaText.h"

#include "objectmanager/model/TypeNames.h"

#include <fmt/format.h>

#include <algorithm>

namespace vkcim {
namespace {

const char* kindOf(const om::ClassDeclaration& declared) {
    return declared.association ? "association" : "class";
}

std::string typeText(const om::PropertyDeclaration& declared) {
    const std::string type = om::typeName(declared.type);
    return declared.referenceClass.empty() ? type : type + " to " + declared.referenceClass;
}

/// A description, and behind it the words for numbers; strings that are their own words need none.
std::string explanation(const om::Qualifiers& qualifiers, const char* indent) {
    std::string text;
    if (const std::string_view description = textOf(qualifiers, "Description"); !description.empty())
        text = fmt::format("{}{}\n", indent, description);
    const std::vector<std::string_view> numbers = textsOf(qualifiers, "ValueMap");
    const std::vector<std::string_view> words = textsOf(qualifiers, "Values");
    std::string list;
    for (std::size_t i = 0; i < std::min(numbers.size(), words.size()); ++i)
        list += fmt::format("{}{} {}", i == 0 ? "" : ", ", numbers[i], words[i]);
    if (!list.empty() && numbers != words) text += fmt::format("{}{}\n", indent, list);
    return text;
}

std::string propertyText(const om::PropertyDeclaration& property) {
    std::string marks = property.key ? ", key" : "";
    if (isMarked(property.qualifiers, "Write")) marks += ", writable";
    return fmt::format("  {}: {}{}\n", property.name, typeText(property), marks) +
           explanation(property.qualifiers, "      ");
}

std::string methodText(const om::MethodDeclaration& method) {
    std::string text = fmt::format("  {}(): {}\n", method.name, om::typeName(method.returnType)) +
                       explanation(method.qualifiers, "      ");
    for (const om::ParameterDeclaration& parameter : method.parameters)
        text += fmt::format("    {}: {}\n", parameter.name, parameterText(parameter)) +
                explanation(parameter.qualifiers, "      ");
    return text;
}

template <class Feature>
bool contains(const std::vector<Feature>& list, const std::string& name) {
    return std::any_of(list.begin(), list.end(), [&](const Feature& each) { return om::sameName(each.name, name); });
}

/// The names in the superclasses that a class does not declare itself; `list` says of what.
template <class Feature>
std::string inherited(const om::ClassDeclaration& declared, const om::Schema& schema, const char* heading,
                      std::vector<Feature> om::ClassDeclaration::*list) {
    std::vector<Feature> found;
    for (const om::ClassDeclaration* each : schema.line(declared.name))
        for (const Feature& feature : each->*list)
            if (!contains(declared.*list, feature.name) && !contains(found, feature.name)) found.push_back(feature);
    std::string names;
    for (const Feature& feature : found) names += (names.empty() ? "" : ", ") + feature.name;
    return names.empty() ? names : fmt::format("\n{}\n  {}\n", heading, names);
}

std::string derived(const om::ClassDeclaration& declared, const om::Schema& schema) {
    std::string names;
    for (const om::ClassDeclaration& each : schema.classes())
        if (om::sameName(each.superclass, declared.name)) names += (names.empty() ? "" : ", ") + each.name;
    return names.empty() ? names : fmt::format("\nClasses derived from it\n  {}\n", names);
}

} // namespace

std::string parameterText(const om::ParameterDeclaration& parameter) {
    const char* direction = !parameter.out ? "in" : parameter.in ? "in and out" : "out";
    return typeText(parameter) + ", " + direction;
}

std::string classesText(const om::Schema& schema) {
    const std::vector<std::string>& names = schema.served();
    std::size_t width = 0;
    for (const std::string& name : names) width = std::max(width, name.size());
    std::string text;
    for (const std::string& name : names) {
        const om::ClassDeclaration& declared = *schema.find(name);
        text += fmt::format("{:<{}}  {:<11}  {}\n", name, width, kindOf(declared), declared.superclass);
    }
    return text;
}

std::string classText(const om::ClassDeclaration& declared, const om::Schema& schema) {
    std::string text = declared.name + ": " + kindOf(declared);
    if (!declared.superclass.empty()) text += " derived from " + declared.superclass;
    text += '\n' + explanation(declared.qualifiers, "  ");
    if (!declared.properties.empty()) text += "\nProperties\n";
    for (const om::PropertyDeclaration& property : declared.properties) text += propertyText(property);
    if (!declared.methods.empty()) text += "\nMethods\n";
    for (const om::MethodDeclaration& method : declared.methods) text += methodText(method);
    // A provider supplies what its class declares itself.
    const std::vector<std::string>& served = schema.served();
    const bool isServed = std::find(served.begin(), served.end(), declared.name) != served.end();
    const char* properties = isServed ? "Inherited properties, not supplied here" : "Inherited properties";
    const char* methods = isServed ? "Inherited methods, not offered here" : "Inherited methods";
    return text + inherited(declared, schema, properties, &om::ClassDeclaration::properties) +
           inherited(declared, schema, methods, &om::ClassDeclaration::methods) + derived(declared, schema);
}

} // namespace vkcim
