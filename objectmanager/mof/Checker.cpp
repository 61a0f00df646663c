#include "objectmanager/mof/Checker.h"

#include "objectmanager/model/QualifierTypes.h"
#include "objectmanager/mof/ClassCheck.h"
#include "objectmanager/mof/Literal.h"

namespace mof {
namespace {

void settle(om::Value& value, CMPIType type) {
    if (std::optional<om::Value> made = typed(value, type)) value = std::move(*made);
}

void settle(om::Qualifiers& qualifiers) {
    for (auto& [name, value] : qualifiers) {
        if (const om::QualifierType* type = om::findQualifierType(name)) settle(value, type->type);
    }
}

/// Gives literals the types of what they stand for, and keys that are overridden their mark.
void settle(om::ClassDeclaration& declared, const om::ResolvedClass* above) {
    settle(declared.qualifiers);
    for (om::PropertyDeclaration& property : declared.properties) {
        settle(property.qualifiers);
        settle(property.defaultValue, property.type);
        const om::PropertyDeclaration* inherited = above == nullptr ? nullptr : above->findProperty(property.name);
        property.key = property.key || (inherited != nullptr && inherited->key);
    }
    for (om::MethodDeclaration& method : declared.methods) {
        settle(method.qualifiers);
        for (om::ParameterDeclaration& parameter : method.parameters) settle(parameter.qualifiers);
    }
}

/// Why a class cannot be taken into the schema; empty if it can.
std::string problemOf(const om::ClassDeclaration& declared, const om::Schema& schema) {
    if (const om::ClassDeclaration* before = schema.find(declared.name)) {
        return "class " + declared.name + " is declared already at " + shown(before->place);
    }
    if (declared.superclass.empty() || schema.find(declared.superclass) != nullptr) return {};
    return "superclass " + declared.superclass + " of " + declared.name + " is not declared";
}

} // namespace

void Checker::add(std::vector<om::ClassDeclaration> classes, bool ours) {
    for (om::ClassDeclaration& declared : classes) {
        const std::string problem = problemOf(declared, known);
        if (problem.empty()) {
            settle(declared, known.resolve(declared.superclass));
            checkClass(known, known.add(std::move(declared)), ours, wrong);
        } else {
            wrong.push_back(shown(declared.place) + ": " + problem);
        }
    }
}

} // namespace mof
