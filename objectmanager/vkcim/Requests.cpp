#include "objectmanager/vkcim/Requests.h"

#include "objectmanager/model/Characters.h"
#include "objectmanager/vkcim/Advice.h"
#include "objectmanager/vkcim/ParseError.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

#include <algorithm>

namespace vkcim {
namespace {

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

/// Reads a text of the user and puts it before what is said of it.
template <typename Read>
auto readText(const std::string& what, std::vector<std::string>* remarks, const Read& read) {
    std::vector<std::string> found;
    try {
        auto result = read(&found);
        for (const std::string& remark : found)
            if (remarks != nullptr) remarks->push_back(what + ": " + remark);
        return result;
    } catch (const ParseError& error) {
        throw std::runtime_error(what + ": " + error.what());
    }
}

/// The class that a query asks for, as far as it can be seen; object managers hand it over in the path.
std::string queriedClass(const std::string& query) {
    std::size_t at = 0;
    bool next = false;
    while (at < query.size()) {
        std::size_t end = at;
        while (end < query.size() && om::isNameByte(query[end])) ++end;
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

void readAssignments(const Arguments& arguments, const om::Schema& schema, om::Request& request,
                     std::vector<std::string>* remarks) {
    const DeclaredType declared = declaredType(request, schema);
    for (const std::string& text : arguments.assignments) {
        request.values.push_back(readText(text, remarks, [&](std::vector<std::string>* found) {
            om::NamedValue value = parseAssignment(text, declared, {request.path.nameSpace, schema, found});
            if (om::findValue(request.values, value.first)) throw ParseError(0, value.first + " is given twice");
            return value;
        }));
    }
}

/// `value` asks all instances of a class, or the one at a path.
om::Operation operationOf(const Command& command, const om::ObjectPath& path) {
    if (command.operation) return *command.operation;
    return path.keys.empty() ? om::Operation::EnumInstances : om::Operation::GetInstance;
}

} // namespace

om::Request makeRequest(const Arguments& arguments, const om::Schema& schema, std::istream& input,
                        std::vector<std::string>* remarks) {
    om::Request request;
    request.propertyList = arguments.properties;
    request.assocClass = arguments.assocClass;
    request.resultClass = arguments.resultClass;
    request.role = arguments.role;
    request.resultRole = arguments.resultRole;
    request.method = arguments.member;
    request.fault = arguments.fault;
    const Takes takes = arguments.command->takes;
    if (takes == Takes::Query) {
        request.operation = om::Operation::ExecQuery;
        request.query = arguments.subject;
        request.language = "WQL";
        request.path.nameSpace = arguments.nameSpace;
        request.path.className = queriedClass(arguments.subject);
        return request;
    }
    const bool piped = takes == Takes::Path && arguments.subject == "-";
    const std::string text = piped ? readLine(input) : arguments.subject;
    request.path = readText("path " + text, remarks, [&](std::vector<std::string>* found) {
        return parsePath(text, arguments.nameSpace, schema, found);
    });
    request.operation = operationOf(*arguments.command, request.path);
    if (takes == Takes::Class && !request.path.keys.empty()) {
        throw std::runtime_error(fmt::format("{}: a class name has no keys", arguments.subject));
    }
    readAssignments(arguments, schema, request, remarks);
    if (remarks == nullptr) return request;
    for (std::string& remark : remarksOn(request, schema)) remarks->push_back(std::move(remark));
    if (arguments.command->action == Action::Value)
        if (std::string remark = remarkOnProperty(request.path.className, arguments.member, schema); !remark.empty())
            remarks->push_back(std::move(remark));
    return request;
}

} // namespace vkcim
