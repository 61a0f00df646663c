#include "objectmanager/endpoint/Call.h"

#include <algorithm>

namespace endpoint {
namespace {

/// Paths of results often lack their namespace.
void qualify(om::ObjectPath& path, const std::string& nameSpace) {
    if (path.nameSpace.empty()) path.nameSpace = nameSpace;
}

} // namespace

const om::ResolvedClass& knownClass(const Call& call, const std::string& name, int code) {
    const om::ResolvedClass* known = call.schema().resolve(name);
    if (known == nullptr) fail(code, "there is no class " + name);
    return *known;
}

om::ObjectPath typedPath(const Call& call, const cimxml::PathElement& element, int unknownClass) {
    const om::ResolvedClass& known = knownClass(call, element.className, unknownClass);
    om::ObjectPath path;
    try {
        path = cimxml::typedPath(element, call.reading());
    } catch (const cimxml::CimError& error) { // a key of another type names no instance
        fail(CMPI_RC_ERR_INVALID_PARAMETER, error.what());
    }
    path.host.clear();
    for (const om::NamedValue& key : path.keys) {
        const auto same = [&key](const om::PropertyDeclaration* each) { return om::sameName(each->name, key.first); };
        if (std::none_of(known.keys.begin(), known.keys.end(), same)) {
            fail(CMPI_RC_ERR_INVALID_PARAMETER, known.declaration->name + " has no key " + key.first);
        }
    }
    return path;
}

void expectAllKeys(const Call& call, const om::ObjectPath& path) {
    for (const om::PropertyDeclaration* key : knownClass(call, path.className).keys) {
        if (om::findValue(path.keys, key->name) == nullptr) {
            fail(CMPI_RC_ERR_INVALID_PARAMETER, "key " + key->name + " is missing");
        }
    }
}

bool isServed(const Call& call, std::string_view className) {
    return om::containsName(call.schema().served(), className);
}

om::Answer ask(const Call& call, const om::Request& request) {
    om::Answer answer;
    try {
        answer = call.space.ask(request);
    } catch (const om::LoadError& error) { // the provider does not offer operations of that kind
        fail(CMPI_RC_ERR_NOT_SUPPORTED, error.what());
    }
    if (answer.code != CMPI_RC_OK) fail(static_cast<int>(answer.code), answer.message.value_or(""));
    for (auto& result : answer.results) {
        if (auto* path = std::get_if<om::ObjectPath>(&result)) {
            qualify(*path, call.space.name);
        } else {
            qualify(std::get<om::Instance>(result).path, call.space.name);
        }
    }
    return answer;
}

void askEach(const Call& call, const std::vector<om::Request>& requests,
             const std::function<void(std::size_t, om::Answer)>& take) {
    std::size_t refused = 0;
    for (std::size_t i = 0; i < requests.size(); ++i) {
        try {
            take(i, ask(call, requests[i]));
        } catch (const cimxml::CimError& error) {
            if (error.code != CMPI_RC_ERR_NOT_SUPPORTED || ++refused == requests.size()) throw;
        }
    }
}

om::Request requestFor(const Call& call, om::Operation operation, om::ObjectPath path) {
    om::Request request;
    request.operation = operation;
    request.path = std::move(path);
    request.path.nameSpace = call.space.name;
    request.principal = call.caller.user;
    return request;
}

om::Request requestFor(const Call& call, om::Operation operation, const std::string& className) {
    om::ObjectPath path;
    path.className = className;
    return requestFor(call, operation, std::move(path));
}

cimxml::Pieces returned(cimxml::Pieces elements) {
    elements.enclose("<IRETURNVALUE>", "</IRETURNVALUE>");
    return elements;
}

} // namespace endpoint
