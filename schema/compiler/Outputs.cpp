#include "schema/compiler/Outputs.h"

#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/TypeNames.h"
#include "objectmanager/mof/ClassCheck.h"

#include <fmt/format.h>
#include <fmt/ranges.h>
#include <nlohmann/json.hpp>

namespace compiler {
namespace {

using fmt::format;
using Json = nlohmann::ordered_json;
using Strings = std::vector<std::string>;

/// A line for each item of a list, made by `text`.
template <class Items, class Text>
Strings each(const Items& items, Text text) {
    Strings found;
    for (const auto& item : items) found.push_back(text(item));
    return found;
}

std::string list(const Strings& items) {
    return format("{{{}}}", fmt::join(items, ", "));
}

std::string lines(const Strings& items) {
    return format("{{{}}}", fmt::join(each(items, [](const auto& item) { return "\n         " + item + ','; }), ""));
}

std::string typeCode(CMPIType type) {
    const CMPIType element = om::elementType(type);
    const std::string name = element == CMPI_dateTime ? "dateTime" : om::typeName(element);
    return format("CMPI_{}{}", name, om::isArray(type) ? "A" : "");
}

std::string printed(const om::Value& value) {
    if (const auto* elements = std::get_if<std::vector<om::Value>>(&value.data)) return list(each(*elements, printed));
    if (const auto* text = std::get_if<std::string>(&value.data)) return quoted(*text);
    if (const auto* flag = std::get_if<bool>(&value.data)) return format("{}", *flag);
    return om::numberText(value);
}

std::string qualifiers(const om::Qualifiers& qualifiers) {
    return list(each(qualifiers, [](const om::NamedValue& each) {
        return format("{{{}, qualifierValue({})}}", quoted(each.first), printed(each.second));
    }));
}

std::string declaration(const om::PropertyDeclaration& declared) {
    return format("{{{}, {}, {}, {}, {}}}", quoted(declared.name), typeCode(declared.type), declared.key,
                  quoted(declared.referenceClass), qualifiers(declared.qualifiers));
}

std::string method(const om::MethodDeclaration& declared) {
    const Strings parameters = each(declared.parameters, [](const om::ParameterDeclaration& each) {
        return format("{{{}, {}, {}}}", declaration(each), each.in, each.out);
    });
    return format("{{{}, {}, {}, {}}}", quoted(declared.name), typeCode(declared.returnType), list(parameters),
                  qualifiers(declared.qualifiers));
}

/// The names of all keys, superclasses' first.
Strings keyNames(const om::Schema& schema, const om::ClassDeclaration& declared) {
    Strings names;
    const std::vector<const om::ClassDeclaration*> line = schema.line(declared.name);
    for (auto c = line.rbegin(); c != line.rend(); ++c) {
        for (const om::PropertyDeclaration& property : (*c)->properties) {
            if (property.key && !om::containsName(names, property.name)) names.push_back(property.name);
        }
    }
    return names;
}

Json facts(const std::string& name, const std::string& type, const om::Qualifiers& qualifiers) {
    Json found{{"name", name}, {"type", type}};
    if (om::findValue(qualifiers, "ValueMap") != nullptr) found["ValueMap"] = om::textsOf(qualifiers, "ValueMap");
    if (om::findValue(qualifiers, "Description") != nullptr)
        found["Description"] = om::textOf(qualifiers, "Description");
    return found;
}

Json facts(const om::PropertyDeclaration& declared) {
    return facts(declared.name, mof::typeText(declared.type, declared.referenceClass), declared.qualifiers);
}

Json described(const om::Schema& schema, const om::ClassDeclaration& declared) {
    Json properties = Json::array();
    for (const om::PropertyDeclaration& property : declared.properties) {
        Json found = facts(property);
        found["key"] = property.key;
        found["write"] = om::isMarked(property.qualifiers, "Write");
        properties.push_back(std::move(found));
    }
    Json methods = Json::array();
    for (const om::MethodDeclaration& method : declared.methods) {
        Json found = facts(method.name, mof::typeText(method.returnType), method.qualifiers);
        found["parameters"] = Json::array();
        for (const om::ParameterDeclaration& parameter : method.parameters)
            found["parameters"].push_back(facts(parameter));
        methods.push_back(std::move(found));
    }
    return {{"name", declared.name},
            {"superclass", declared.superclass.empty() ? Json() : Json(declared.superclass)},
            {"association", declared.association},
            {"keys", keyNames(schema, declared)},
            {"properties", std::move(properties)},
            {"methods", std::move(methods)}};
}

} // namespace

std::string quoted(const std::string& text) {
    return Json(text).dump(-1, ' ', true);
}

std::string tableText(const om::Schema& schema) {
    std::string classes;
    for (const om::ClassDeclaration& declared : schema.classes()) {
        classes +=
            format("    {{{}, {}, {},\n     {},\n     {},\n     {}}},\n", quoted(declared.name),
                   quoted(declared.superclass), declared.association, lines(each(declared.properties, declaration)),
                   lines(each(declared.methods, method)), qualifiers(declared.qualifiers));
    }
    return format(R"(// Made from the MOF files at build time.
#include "objectmanager/model/Schema.h"

namespace om {{

const Schema& Schema::builtin() {{
    static const Schema schema(std::vector<ClassDeclaration>{{
{}    }});
    return schema;
}}

}} // namespace om
)",
                  classes);
}

std::string describedText(const om::Schema& schema, const Classes& ours) {
    Json classes = Json::array();
    for (const om::ClassDeclaration* declared : ours) classes.push_back(described(schema, *declared));
    return Json{{"classes", std::move(classes)}}.dump(1, ' ', true) + '\n';
}

} // namespace compiler
