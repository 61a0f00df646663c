#include "objectmanager/vkcim/Advice.h"

#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/SchemaText.h"
#include "objectmanager/vkcim/Suggestion.h"

#include <fmt/format.h>

#include <algorithm>

namespace vkcim {
namespace {

template <class Named>
std::vector<std::string> namesOf(const std::vector<Named>& all) {
    std::vector<std::string> names;
    names.reserve(all.size());
    for (const Named& each : all) names.push_back(each.name);
    return names;
}

/// The nearest of the names there are, or all of them.
std::string namesInstead(const std::string& name, const std::vector<std::string>& known, const char* what) {
    if (known.empty()) return "; it has none";
    const auto nearest = nearestName(name, known);
    return nearest ? didYouMean(nearest) : fmt::format("; its {}: {}", what, fmt::join(known, ", "));
}

/// The properties of a class, those of its superclasses behind its own.
std::vector<std::string> propertyNames(const std::string& className, const om::Schema& schema) {
    std::vector<std::string> names;
    for (const om::ClassDeclaration* each : schema.line(className))
        for (const om::PropertyDeclaration& property : each->properties) names.push_back(property.name);
    return names;
}

/// A type that was written out, or that a text without one seemed to have.
void remarkOnType(const std::string& declaredName, const std::string& owner, CMPIType declared, const om::Value& value,
                  std::vector<std::string>& remarks) {
    if (value.type != declared)
        remarks.push_back(fmt::format("{} of {} is {}, not {}", declaredName, owner, om::typeName(declared),
                                      om::typeName(value.type)));
}

void remarkOnProperties(const om::Request& request, const om::ClassDeclaration& declared, const om::Schema& schema,
                        std::vector<std::string>& remarks) {
    const bool modifies = request.operation == om::Operation::ModifyInstance;
    for (const auto& [name, value] : request.values) {
        const om::PropertyDeclaration* property = schema.findProperty(declared.name, name);
        if (property == nullptr) {
            remarks.push_back(remarkOnProperty(declared.name, name, schema));
            continue;
        }
        if (modifies && !om::isMarked(property->qualifiers, "Write"))
            remarks.push_back(fmt::format("{} of {} is not writable", property->name, declared.name));
        remarkOnType(property->name, declared.name, property->type, value, remarks);
    }
}

void remarkOnMethod(const om::Request& request, const om::ClassDeclaration& declared, const om::Schema& schema,
                    std::vector<std::string>& remarks) {
    const om::MethodDeclaration* method = schema.findMethod(declared.name, request.method);
    if (method == nullptr) {
        remarks.push_back(fmt::format("{} has no method {}{}", declared.name, request.method,
                                      namesInstead(request.method, namesOf(declared.methods), "methods")));
        return;
    }
    const std::vector<std::string> known = namesOf(method->parameters);
    for (const auto& [name, value] : request.values) {
        const auto parameter =
            std::find_if(method->parameters.begin(), method->parameters.end(),
                         [&given = name](const auto& each) { return om::sameName(each.name, given); });
        if (parameter == method->parameters.end())
            remarks.push_back(
                fmt::format("{} has no parameter {}{}", method->name, name, namesInstead(name, known, "parameters")));
        else
            remarkOnType(parameter->name, method->name, parameter->type, value, remarks);
    }
}

/// The parameters of the method that was called, with their types, and which of them were not given.
std::vector<std::string> adviceOnArguments(const om::Request& request, const om::MethodDeclaration& method) {
    std::vector<std::string> all;
    std::vector<std::string> missing;
    for (const om::ParameterDeclaration& parameter : method.parameters) {
        all.push_back(fmt::format("{} ({})", parameter.name, parameterText(parameter)));
        if (parameter.in && !om::findValue(request.values, parameter.name)) missing.push_back(parameter.name);
    }
    std::vector<std::string> advice = {fmt::format("{} takes {}", method.name, fmt::join(all, ", "))};
    if (!missing.empty()) advice.push_back(fmt::format("not given: {}", fmt::join(missing, ", ")));
    return advice;
}

std::vector<std::string> adviceOnMethod(const om::Request& request, int status, const om::Schema& schema) {
    const om::ClassDeclaration* declared = schema.find(request.path.className);
    const om::MethodDeclaration* method = schema.findMethod(request.path.className, request.method);
    if (declared == nullptr || method == nullptr) return {}; // that was said before
    const std::vector<std::string> own = namesOf(declared->methods);
    if (!om::containsName(own, method->name))
        return {fmt::format("{} inherits {}; its own methods: {}", declared->name, method->name, fmt::join(own, ", "))};
    if (status == CMPI_RC_ERR_INVALID_PARAMETER) return adviceOnArguments(request, *method);
    return {};
}

std::vector<std::string> adviceOnClass(const std::string& className, const om::Schema& schema) {
    const om::ClassDeclaration* declared = schema.find(className);
    if (declared == nullptr) {
        const auto nearest = nearestClass(className, schema);
        return {"there is no class " + className + (nearest ? didYouMean(nearest) : " in the schema")};
    }
    std::vector<std::string> below = schema.servedBelow(declared->name);
    std::erase_if(below, [&](const std::string& each) { return om::sameName(each, declared->name); });
    if (below.empty()) return {};
    return {fmt::format("ask for a class below {}: {}", declared->name, fmt::join(below, ", "))};
}

bool isAssociation(om::Operation operation) {
    return operation == om::Operation::Associators || operation == om::Operation::AssociatorNames;
}

} // namespace

std::string remarkOnProperty(const std::string& className, const std::string& property, const om::Schema& schema) {
    const om::ClassDeclaration* declared = schema.find(className);
    if (declared == nullptr || schema.findProperty(className, property) != nullptr) return {};
    return fmt::format("{} has no property {}{}", declared->name, property,
                       didYouMean(nearestName(property, propertyNames(className, schema))));
}

std::vector<std::string> remarksOn(const om::Request& request, const om::Schema& schema) {
    std::vector<std::string> remarks;
    const om::ClassDeclaration* declared = schema.find(request.path.className);
    if (declared == nullptr) return remarks;
    if (request.operation == om::Operation::ModifyInstance || request.operation == om::Operation::CreateInstance)
        remarkOnProperties(request, *declared, schema, remarks);
    if (request.operation == om::Operation::InvokeMethod) remarkOnMethod(request, *declared, schema, remarks);
    return remarks;
}

std::vector<std::string> adviceOn(const om::Request& request, int status, const om::Schema& schema) {
    if (request.operation == om::Operation::InvokeMethod && status != CMPI_RC_ERR_INVALID_CLASS)
        return adviceOnMethod(request, status, schema);
    if (status != CMPI_RC_ERR_INVALID_CLASS) return {};
    for (const std::string& className : {request.path.className, request.assocClass.value_or("")}) {
        if (className.empty()) continue;
        std::vector<std::string> advice = adviceOnClass(className, schema);
        if (!advice.empty()) return advice;
    }
    if (isAssociation(request.operation) && !request.assocClass)
        return {"the association's class may have to be named: --assoc-class"};
    return {};
}

} // namespace vkcim
