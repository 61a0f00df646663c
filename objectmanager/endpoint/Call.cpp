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

std::vector<std::string> servedBelow(const Call& call, std::string_view className) {
    std::vector<std::string> found = call.schema().served();
    found.erase(std::remove_if(found.begin(), found.end(),
                               [&](const std::string& each) { return !call.schema().isA(each, className); }),
                found.end());
    return found;
}

bool isServed(const Call& call, std::string_view className) {
    const std::vector<std::string> served = call.schema().served();
    return std::any_of(served.begin(), served.end(),
                       [&](const std::string& each) { return om::sameName(each, className); });
}

om::Answer ask(const Call& call, om::Request request) {
    request.principal = call.caller.user;
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

om::Answer askAll(const Call& call, const std::vector<om::Request>& requests) {
    om::Answer all;
    std::size_t refused = 0;
    for (const om::Request& request : requests) {
        try {
            om::Answer answer = ask(call, request);
            std::move(answer.results.begin(), answer.results.end(), std::back_inserter(all.results));
        } catch (const cimxml::CimError& error) {
            if (error.code != CMPI_RC_ERR_NOT_SUPPORTED || ++refused == requests.size()) throw;
        }
    }
    return all;
}

om::Request requestFor(const Call& call, om::Operation operation, om::ObjectPath path) {
    om::Request request;
    request.operation = operation;
    request.path = std::move(path);
    request.path.nameSpace = call.space.name;
    return request;
}

om::Request requestFor(const Call& call, om::Operation operation, const std::string& className) {
    om::ObjectPath path;
    path.className = className;
    return requestFor(call, operation, std::move(path));
}

std::string returned(const std::string& elements) {
    cimxml::Writer writer;
    writer.open("IRETURNVALUE");
    writer.raw(elements);
    writer.close("IRETURNVALUE");
    return writer.take();
}

} // namespace endpoint
