#include "objectmanager/endpoint/ClassElements.h"

#include "objectmanager/endpoint/Qualifiers.h"
#include "objectmanager/endpoint/Selection.h"
#include "objectmanager/model/TypeNames.h"

#include <algorithm>

namespace endpoint {
namespace {

/// A declaration as a class shows it: the nearest one, and those that it overrides.
template <class T>
using Line = std::vector<const T*>;

template <class T>
std::vector<const om::Qualifiers*> qualifiersOf(const Line<T>& line) {
    std::vector<const om::Qualifiers*> found;
    for (const T* each : line) found.push_back(&each->qualifiers);
    return found;
}

/// Properties or methods of a class, inherited ones first, each with the declarations that it overrides.
template <class T>
std::vector<Line<T>> members(const std::vector<const om::ClassDeclaration*>& classes,
                             std::vector<T> om::ClassDeclaration::*member) {
    std::vector<Line<T>> found;
    for (auto c = classes.rbegin(); c != classes.rend(); ++c) {
        for (const T& each : (*c)->*member) {
            const auto known = std::find_if(found.begin(), found.end(), [&](const Line<T>& line) {
                return om::sameName(line.front()->name, each.name);
            });
            if (known == found.end()) {
                found.push_back({&each});
            } else {
                known->insert(known->begin(), &each);
            }
        }
    }
    return found;
}

class ClassWriter {
public:
    ClassWriter(cimxml::Writer& target, const om::Schema& classes, const om::ClassDeclaration& written,
                const ClassSelection& parts)
        : writer(target), schema(classes), declared(written), selection(parts), line(classes.line(written.name)) {}

    void write() {
        if (declared.superclass.empty()) {
            writer.open("CLASS", {{"NAME", declared.name}});
        } else {
            writer.open("CLASS", {{"NAME", declared.name}, {"SUPERCLASS", declared.superclass}});
        }
        if (selection.qualifiers) writeQualifiers(writer, qualifiersOf(line));
        for (const auto& each : members(line, &om::ClassDeclaration::properties)) {
            if (isOwn(*each.front(), declared.properties) || !selection.localOnly) property(each);
        }
        for (const auto& each : members(line, &om::ClassDeclaration::methods)) {
            if (isOwn(*each.front(), declared.methods) || !selection.localOnly) method(each);
        }
        writer.close("CLASS");
    }

private:
    template <class T>
    static bool isOwn(const T& each, const std::vector<T>& list) {
        return std::any_of(list.begin(), list.end(), [&](const T& own) { return &own == &each; });
    }

    bool wants(const std::string& name) const {
        return !selection.properties || om::containsName(*selection.properties, name);
    }

    void property(const Line<om::PropertyDeclaration>& each) {
        const om::PropertyDeclaration& nearest = *each.front();
        if (!wants(nearest.name)) return;
        const bool array = om::isArray(nearest.type);
        const bool reference = nearest.type == CMPI_ref;
        const char* const element = reference ? "PROPERTY.REFERENCE" : array ? "PROPERTY.ARRAY" : "PROPERTY";
        std::vector<std::pair<std::string_view, std::string_view>> attributes = {{"NAME", nearest.name}};
        const std::string type = cimxml::typeName(nearest.type);
        if (reference) {
            attributes.emplace_back("REFERENCECLASS", nearest.referenceClass);
        } else {
            attributes.emplace_back("TYPE", type);
        }
        if (selection.origins) {
            attributes.emplace_back("CLASSORIGIN", originOfProperty(schema, declared.name, nearest.name));
        }
        if (!isOwn(nearest, declared.properties)) attributes.emplace_back("PROPAGATED", "true");
        writer.open(element, attributes);
        if (selection.qualifiers) writeQualifiers(writer, qualifiersOf(each));
        writer.close(element);
    }

    void method(const Line<om::MethodDeclaration>& each) {
        const om::MethodDeclaration& nearest = *each.front();
        const std::string type = cimxml::typeName(nearest.returnType);
        std::vector<std::pair<std::string_view, std::string_view>> attributes = {{"NAME", nearest.name},
                                                                                 {"TYPE", type}};
        if (selection.origins) {
            attributes.emplace_back("CLASSORIGIN", originOfMethod(schema, declared.name, nearest.name));
        }
        if (!isOwn(nearest, declared.methods)) attributes.emplace_back("PROPAGATED", "true");
        writer.open("METHOD", attributes);
        if (selection.qualifiers) writeQualifiers(writer, qualifiersOf(each));
        for (const om::ParameterDeclaration& parameter : nearest.parameters) this->parameter(parameter);
        writer.close("METHOD");
    }

    void parameter(const om::ParameterDeclaration& parameter) {
        const bool array = om::isArray(parameter.type);
        const bool reference = om::elementType(parameter.type) == CMPI_ref;
        const char* const element = reference ? (array ? "PARAMETER.REFARRAY" : "PARAMETER.REFERENCE")
                                              : (array ? "PARAMETER.ARRAY" : "PARAMETER");
        if (reference) {
            writer.open(element, {{"NAME", parameter.name}, {"REFERENCECLASS", parameter.referenceClass}});
        } else {
            writer.open(element, {{"NAME", parameter.name}, {"TYPE", cimxml::typeName(parameter.type)}});
        }
        if (selection.qualifiers) writeQualifiers(writer, {&parameter.qualifiers});
        writer.close(element);
    }

    cimxml::Writer& writer;
    const om::Schema& schema;
    const om::ClassDeclaration& declared;
    const ClassSelection& selection;
    std::vector<const om::ClassDeclaration*> line;
};

} // namespace

ClassSelection ClassSelection::of(const Call& call, bool qualifiersByDefault) {
    ClassSelection selection;
    selection.localOnly = call.parameters.flag("LocalOnly", true);
    selection.qualifiers = call.parameters.flag("IncludeQualifiers", qualifiersByDefault);
    selection.origins = call.parameters.flag("IncludeClassOrigin", false);
    selection.properties = call.parameters.names("PropertyList");
    return selection;
}

void writeClass(cimxml::Writer& writer, const om::Schema& schema, const om::ClassDeclaration& declared,
                const ClassSelection& selection) {
    ClassWriter(writer, schema, declared, selection).write();
}

} // namespace endpoint
