#include "objectmanager/endpoint/Qualifiers.h"

#include "objectmanager/cimxml/Typing.h"
#include "objectmanager/model/Names.h"

#include <algorithm>
#include <set>

namespace endpoint {
namespace {

constexpr bool fixed = false; // what a subclass may not change
constexpr bool restricted = false;

constexpr std::string_view flag(bool value) {
    return value ? "true" : "false";
}

bool isArray(CMPIType type) {
    return (type & CMPI_ARRAY) != 0;
}

bool has(const QualifierType& type, char scope) {
    return type.scopes.find(scope) != std::string_view::npos;
}

om::Value defaultOf(const QualifierType& type) {
    if (type.otherwise.empty()) return {type.type, {}};
    static const om::Schema none({});
    cimxml::ValueElement element;
    element.kind = cimxml::ValueElement::Kind::Text;
    element.text = type.otherwise;
    return cimxml::typedValue(element, type.type, {none, {}, cimxml::Trust::Schema});
}

void writeQualifier(cimxml::Writer& writer, const om::NamedValue& qualifier, bool propagated) {
    const QualifierType* type = findQualifierType(qualifier.first);
    writer.open("QUALIFIER", {{"NAME", type != nullptr ? type->name : std::string_view(qualifier.first)},
                              {"TYPE", cimxml::typeName(qualifier.second.type)},
                              {"PROPAGATED", flag(propagated)},
                              {"OVERRIDABLE", flag(type == nullptr || type->overridable)},
                              {"TOSUBCLASS", flag(type == nullptr || type->inherited)},
                              {"TRANSLATABLE", flag(type != nullptr && type->translatable)}});
    writer.value(qualifier.second);
    writer.close("QUALIFIER");
}

} // namespace

const std::vector<QualifierType>& qualifierTypes() {
    constexpr std::string_view any = "carpmin";
    static const std::vector<QualifierType> types = {
        {"Abstract", CMPI_boolean, "can", true, restricted, false, "false"},
        {"Aggregate", CMPI_boolean, "r", fixed, true, false, "false"},
        {"Aggregation", CMPI_boolean, "a", fixed, true, false, "false"},
        {"ArrayType", CMPI_string, "pi", fixed, true, false, "Bag"},
        {"Association", CMPI_boolean, "a", fixed, true, false, "false"},
        {"BitMap", CMPI_stringA, "pmi", true, true, false, {}},
        {"BitValues", CMPI_stringA, "pmi", true, true, true, {}},
        {"ClassConstraint", CMPI_stringA, "can", true, true, false, {}},
        {"Correlatable", CMPI_stringA, "p", true, true, false, {}},
        {"Counter", CMPI_boolean, "pmi", true, true, false, "false"},
        {"Deprecated", CMPI_stringA, any, true, restricted, false, {}},
        {"Description", CMPI_string, any, true, true, true, {}},
        {"DisplayName", CMPI_string, any, true, true, true, {}},
        {"DN", CMPI_boolean, "pmi", fixed, true, false, "false"},
        {"EmbeddedInstance", CMPI_string, "pmi", true, true, false, {}},
        {"EmbeddedObject", CMPI_boolean, "pmi", fixed, true, false, "false"},
        {"Exception", CMPI_boolean, "cn", fixed, true, false, "false"},
        {"Experimental", CMPI_boolean, any, true, restricted, false, "false"},
        {"Gauge", CMPI_boolean, "pmi", true, true, false, "false"},
        {"In", CMPI_boolean, "i", fixed, true, false, "true"},
        {"IsPUnit", CMPI_boolean, "pmi", true, true, false, "false"},
        {"Key", CMPI_boolean, "pr", fixed, true, false, "false"},
        {"MappingStrings", CMPI_stringA, any, true, true, false, {}},
        {"Max", CMPI_uint32, "r", true, true, false, {}},
        {"MaxLen", CMPI_uint32, "pmi", true, true, false, {}},
        {"MaxValue", CMPI_sint64, "pmi", true, true, false, {}},
        {"MethodConstraint", CMPI_stringA, "m", true, true, false, {}},
        {"Min", CMPI_uint32, "r", true, true, false, "0"},
        {"MinLen", CMPI_uint32, "pmi", true, true, false, "0"},
        {"MinValue", CMPI_sint64, "pmi", true, true, false, {}},
        {"ModelCorrespondence", CMPI_stringA, any, true, true, false, {}},
        {"NullValue", CMPI_string, "p", true, true, false, {}},
        {"OctetString", CMPI_boolean, "pmi", fixed, true, false, "false"},
        {"Out", CMPI_boolean, "i", fixed, true, false, "false"},
        {"Override", CMPI_string, "prm", true, restricted, false, {}},
        {"Propagated", CMPI_string, "p", fixed, true, false, {}},
        {"PropertyConstraint", CMPI_stringA, "pr", true, true, false, {}},
        {"PUnit", CMPI_string, "pmi", true, true, false, {}},
        {"Read", CMPI_boolean, "pr", true, true, false, "true"},
        {"Required", CMPI_boolean, "prmi", fixed, true, false, "false"},
        {"Static", CMPI_boolean, "pm", fixed, true, false, "false"},
        {"Terminal", CMPI_boolean, "can", true, true, false, "false"},
        {"UMLPackagePath", CMPI_string, "can", true, true, false, {}},
        {"Units", CMPI_string, "pmi", true, true, true, {}},
        {"ValueMap", CMPI_stringA, "pmi", true, true, false, {}},
        {"Values", CMPI_stringA, "pmi", true, true, true, {}},
        {"Version", CMPI_string, "can", true, restricted, true, {}},
        {"Weak", CMPI_boolean, "r", fixed, true, false, "false"},
        {"Write", CMPI_boolean, "pr", true, true, false, "false"},
    };
    return types;
}

const QualifierType* findQualifierType(std::string_view name) {
    const std::vector<QualifierType>& types = qualifierTypes();
    const auto found = std::find_if(types.begin(), types.end(),
                                    [&](const QualifierType& each) { return om::sameName(each.name, name); });
    return found == types.end() ? nullptr : &*found;
}

void writeQualifierType(cimxml::Writer& writer, const QualifierType& type) {
    writer.open("QUALIFIER.DECLARATION", {{"NAME", type.name},
                                          {"TYPE", cimxml::typeName(type.type)},
                                          {"ISARRAY", flag(isArray(type.type))},
                                          {"OVERRIDABLE", flag(type.overridable)},
                                          {"TOSUBCLASS", flag(type.inherited)},
                                          {"TRANSLATABLE", flag(type.translatable)}});
    writer.empty("SCOPE", {{"CLASS", flag(has(type, 'c'))},
                           {"ASSOCIATION", flag(has(type, 'a'))},
                           {"REFERENCE", flag(has(type, 'r'))},
                           {"PROPERTY", flag(has(type, 'p'))},
                           {"METHOD", flag(has(type, 'm'))},
                           {"PARAMETER", flag(has(type, 'i'))},
                           {"INDICATION", flag(has(type, 'n'))}});
    writer.value(defaultOf(type));
    writer.close("QUALIFIER.DECLARATION");
}

void writeQualifiers(cimxml::Writer& writer, const std::vector<const om::Qualifiers*>& line) {
    std::set<const QualifierType*> written;
    for (const om::Qualifiers* qualifiers : line) {
        const bool own = qualifiers == line.front();
        for (const om::NamedValue& qualifier : *qualifiers) {
            const QualifierType* type = findQualifierType(qualifier.first);
            if (!own && (type == nullptr || !type->inherited)) continue;
            if (type != nullptr && !written.insert(type).second) continue;
            writeQualifier(writer, qualifier, !own);
        }
    }
}

} // namespace endpoint
