#include "objectmanager/vkcim/Requests.h"

#include "objectmanager/vkcim/Characters.h"
#include "objectmanager/vkcim/Commands.h"
#include "objectmanager/vkcim/ParseError.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

#include <algorithm>

namespace vkcim {
namespace {

Takes taken(om::Operation operation) {
    return std::find_if(std::begin(commands), std::end(commands),
                        [&](const Command& each) { return each.operation == operation; })
        ->takes;
}

std::string readLine(std::istream& input) {
    std::string line;
    std::getline(input, line);
    if (!line.empty() && line.back() == '\r') line.pop_back();
    if (line.empty()) throw std::runtime_error("standard input holds no path");
    if (const std::size_t zero = line.find('\0'); zero != std::string::npos) {
        throw std::runtime_error(fmt::format("the path on standard input holds a zero byte at {}", zero));
    }
    return line;
}

om::ObjectPath readPath(const std::string& text, const Arguments& arguments, const om::Schema& schema) {
    try {
        return parsePath(text, arguments.nameSpace, schema);
    } catch (const ParseError& error) {
        throw std::runtime_error(fmt::format("path {}: {}", text, error.what()));
    }
}

/// The class that a query asks for, as far as it can be seen; object managers hand it over in the path.
std::string queriedClass(const std::string& query) {
    std::size_t at = 0;
    bool next = false;
    while (at < query.size()) {
        std::size_t end = at;
        while (end < query.size() && isNameByte(query[end])) ++end;
        std::string word = query.substr(at, end - at);
        if (next && !word.empty()) return word;
        next = next || om::sameName(word, "FROM");
        at = std::max(end, at + 1);
    }
    return {};
}

DeclaredType declaredType(const om::Request& request, const om::Schema& schema) {
    if (request.operation != om::Operation::InvokeMethod) {
        return [&](const std::string& name) -> std::optional<CMPIType> {
            const om::PropertyDeclaration* property = schema.findProperty(request.path.className, name);
            return property ? std::optional<CMPIType>(property->type) : std::nullopt;
        };
    }
    return [&](const std::string& name) -> std::optional<CMPIType> {
        const om::MethodDeclaration* method = schema.findMethod(request.path.className, request.method);
        if (!method) return std::nullopt;
        for (const om::ParameterDeclaration& parameter : method->parameters) {
            if (om::sameName(parameter.name, name)) return parameter.type;
        }
        return std::nullopt;
    };
}

void readAssignments(const Arguments& arguments, const om::Schema& schema, om::Request& request) {
    const DeclaredType declared = declaredType(request, schema);
    for (const std::string& text : arguments.assignments) {
        try {
            om::NamedValue value = parseAssignment(text, declared, {request.path.nameSpace, schema});
            for (const om::NamedValue& known : request.values) {
                if (om::sameName(known.first, value.first)) throw ParseError(0, value.first + " is given twice");
            }
            request.values.push_back(std::move(value));
        } catch (const ParseError& error) {
            throw std::runtime_error(fmt::format("{}: {}", text, error.what()));
        }
    }
}

} // namespace

om::Request makeRequest(const Arguments& arguments, const om::Schema& schema, std::istream& input) {
    om::Request request;
    request.operation = arguments.operation.value();
    request.propertyList = arguments.properties;
    request.assocClass = arguments.assocClass;
    request.resultClass = arguments.resultClass;
    request.role = arguments.role;
    request.resultRole = arguments.resultRole;
    request.method = arguments.method;
    request.fault = arguments.fault;
    const Takes takes = taken(request.operation);
    if (takes == Takes::Query) {
        request.query = arguments.subject;
        request.language = "WQL";
        request.path.nameSpace = arguments.nameSpace;
        request.path.className = queriedClass(arguments.subject);
        return request;
    }
    const bool piped = takes == Takes::Path && arguments.subject == "-";
    request.path = readPath(piped ? readLine(input) : arguments.subject, arguments, schema);
    if (takes == Takes::Class && !request.path.keys.empty()) {
        throw std::runtime_error(fmt::format("{}: a class name has no keys", arguments.subject));
    }
    readAssignments(arguments, schema, request);
    return request;
}

} // namespace vkcim
