#include "objectmanager/endpoint/Qualifiers.h"

#include "objectmanager/cimxml/Typing.h"
#include "objectmanager/model/TypeNames.h"

#include <set>

namespace endpoint {
namespace {

constexpr std::string_view flag(bool value) {
    return value ? "true" : "false";
}

bool has(const om::QualifierType& type, char scope) {
    return type.scopes.find(scope) != std::string_view::npos;
}

om::Value defaultOf(const om::QualifierType& type) {
    if (type.otherwise.empty()) return {type.type, {}};
    static const om::Schema none({});
    cimxml::ValueElement element;
    element.kind = cimxml::ValueElement::Kind::Text;
    element.text = type.otherwise;
    return cimxml::typedValue(element, type.type, {none, {}, cimxml::Trust::Schema});
}

void writeQualifier(cimxml::Writer& writer, const om::NamedValue& qualifier, bool propagated) {
    const om::QualifierType* type = om::findQualifierType(qualifier.first);
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

void writeQualifierType(cimxml::Writer& writer, const om::QualifierType& type) {
    writer.open("QUALIFIER.DECLARATION", {{"NAME", type.name},
                                          {"TYPE", cimxml::typeName(type.type)},
                                          {"ISARRAY", flag(om::isArray(type.type))},
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
    std::set<const om::QualifierType*> written;
    for (const om::Qualifiers* qualifiers : line) {
        const bool own = qualifiers == line.front();
        for (const om::NamedValue& qualifier : *qualifiers) {
            const om::QualifierType* type = om::findQualifierType(qualifier.first);
            if (!own && (type == nullptr || !type->inherited)) continue;
            if (type != nullptr && !written.insert(type).second) continue;
            writeQualifier(writer, qualifier, !own);
        }
    }
}

} // namespace endpoint
