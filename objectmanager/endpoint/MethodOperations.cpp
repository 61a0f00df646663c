#include "objectmanager/endpoint/Call.h"
#include "objectmanager/endpoint/Operations.h"

#include <algorithm>

namespace endpoint {
namespace {

const om::ParameterDeclaration& declaredParameter(const om::MethodDeclaration& method, const std::string& name) {
    for (const om::ParameterDeclaration& parameter : method.parameters) {
        if (om::sameName(parameter.name, name)) return parameter;
    }
    fail(CMPI_RC_ERR_INVALID_PARAMETER, method.name + " has no parameter " + name);
}

/// The type comes from the class; many clients state none. One that states another sends something else than it means.
void checkStated(const cimxml::ParameterElement& element, const om::ParameterDeclaration& declared) {
    if (element.type.empty() || element.type == cimxml::typeName(declared.type)) return;
    fail(CMPI_RC_ERR_INVALID_PARAMETER, "parameter " + declared.name + " is " + cimxml::typeName(declared.type));
}

std::vector<om::NamedValue> typedArguments(const Call& call, const om::MethodDeclaration& method) {
    std::vector<om::NamedValue> arguments;
    for (const cimxml::ParameterElement& element : call.request.parameters) {
        const om::ParameterDeclaration& declared = declaredParameter(method, element.name);
        if (om::findValue(arguments, declared.name) != nullptr) {
            fail(CMPI_RC_ERR_INVALID_PARAMETER, "parameter " + declared.name + " is given twice");
        }
        checkStated(element, declared);
        try {
            om::Value value = cimxml::typedValue(element.value, declared.type, call.reading());
            arguments.emplace_back(declared.name, std::move(value));
        } catch (const cimxml::CimError& error) {
            fail(CMPI_RC_ERR_INVALID_PARAMETER, "parameter " + declared.name + ": " + error.what());
        }
    }
    return arguments;
}

} // namespace

cimxml::Pieces invokeMethod(const Call& call) {
    const cimxml::PathElement& target = call.request.target;
    const om::ObjectPath path = typedPath(call, target, CMPI_RC_ERR_NOT_FOUND);
    const om::MethodDeclaration* method = call.schema().findMethod(path.className, call.request.name);
    if (method == nullptr) fail(CMPI_RC_ERR_METHOD_NOT_FOUND, path.className + " has no method " + call.request.name);
    // A provider runs the methods that its class declares itself, and no inherited one.
    const auto& own = call.schema().find(path.className)->methods;
    const bool available =
        std::any_of(own.begin(), own.end(), [&](const om::MethodDeclaration& each) { return &each == method; });
    if (!available || !isServed(call, path.className)) fail(CMPI_RC_ERR_METHOD_NOT_AVAILABLE, "");
    if (target.instance) expectAllKeys(call, path);
    om::Request request = requestFor(call, om::Operation::InvokeMethod, path);
    request.method = method->name;
    request.values = typedArguments(call, *method);
    const om::Answer answer = ask(call, request);
    cimxml::Writer writer;
    // Some clients fail on a value that is missing, so nulls are left out.
    if (answer.returnValue && !answer.returnValue->isNull()) writer.returnValue(*answer.returnValue);
    for (const auto& [name, value] : answer.out) {
        if (!value.isNull()) writer.parameter(name, value);
    }
    return writer.take();
}

} // namespace endpoint
