#include "objectmanager/endpoint/Operations.h"

#include "objectmanager/cimxml/Message.h"
#include "objectmanager/endpoint/Call.h"

#include <algorithm>
#include <exception>

namespace endpoint {
namespace {

using Names = std::vector<std::string_view>;

constexpr std::size_t usualMessage = 4096; ///< bytes, more than most have

struct Row {
    std::string_view name;
    cimxml::Pieces (*run)(const Call&); ///< null: an operation that nothing here serves
    bool changes;
    Names parameters;
};

Names operator+(Names left, const Names& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

/// Every intrinsic operation of the standard.
const std::vector<Row>& rows() {
    static const Names instanceParts = {"IncludeClassOrigin", "PropertyList"};
    static const Names parts = Names{"IncludeQualifiers"} + instanceParts;
    static const Names through = {"AssocClass", "ResultClass", "Role", "ResultRole"};
    static const Names to = {"ResultClass", "Role"};
    static const Names opening = {"FilterQueryLanguage", "FilterQuery", "OperationTimeout", "ContinueOnError",
                                  "MaxObjectCount"};
    static const Names pulling = {"EnumerationContext", "MaxObjectCount"};
    static const std::vector<Row> table = {
        {"GetInstance", getInstance, false, Names{"InstanceName", "LocalOnly"} + parts},
        {"EnumerateInstances", enumerateInstances, false, Names{"ClassName", "LocalOnly", "DeepInheritance"} + parts},
        {"EnumerateInstanceNames", enumerateInstanceNames, false, {"ClassName"}},
        {"CreateInstance", createInstance, true, {"NewInstance"}},
        {"ModifyInstance", modifyInstance, true, {"ModifiedInstance", "IncludeQualifiers", "PropertyList"}},
        {"DeleteInstance", deleteInstance, true, {"InstanceName"}},
        {"GetProperty", getProperty, false, {"InstanceName", "PropertyName"}},
        {"SetProperty", setProperty, true, {"InstanceName", "PropertyName", "NewValue"}},
        {"Associators", associators, false, Names{"ObjectName"} + through + parts},
        {"AssociatorNames", associatorNames, false, Names{"ObjectName"} + through},
        {"References", references, false, Names{"ObjectName"} + to + parts},
        {"ReferenceNames", referenceNames, false, Names{"ObjectName"} + to},
        {"GetClass", getClass, false, Names{"ClassName", "LocalOnly"} + parts},
        {"EnumerateClasses",
         enumerateClasses,
         false,
         {"ClassName", "DeepInheritance", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin"}},
        {"EnumerateClassNames", enumerateClassNames, false, {"ClassName", "DeepInheritance"}},
        {"GetQualifier", getQualifier, false, {"QualifierName"}},
        {"EnumerateQualifiers", enumerateQualifiers, false, {}},
        {"OpenEnumerateInstances", openEnumerateInstances, false,
         Names{"ClassName", "DeepInheritance"} + instanceParts + opening},
        {"OpenEnumerateInstancePaths", openEnumerateInstancePaths, false, Names{"ClassName"} + opening},
        {"OpenAssociatorInstances", openAssociatorInstances, false,
         Names{"InstanceName"} + through + instanceParts + opening},
        {"OpenAssociatorInstancePaths", openAssociatorInstancePaths, false, Names{"InstanceName"} + through + opening},
        {"OpenReferenceInstances", openReferenceInstances, false, Names{"InstanceName"} + to + instanceParts + opening},
        {"OpenReferenceInstancePaths", openReferenceInstancePaths, false, Names{"InstanceName"} + to + opening},
        {"PullInstancesWithPath", pullInstancesWithPath, false, pulling},
        {"PullInstancePaths", pullInstancePaths, false, pulling},
        {"CloseEnumeration", closeEnumeration, false, {"EnumerationContext"}},
        {"ExecQuery", nullptr, false, {}},
        {"OpenQueryInstances", nullptr, false, {}},
        {"PullInstances", nullptr, false, {}},
        {"EnumerationCount", nullptr, false, {}},
        {"CreateClass", nullptr, true, {}},
        {"ModifyClass", nullptr, true, {}},
        {"DeleteClass", nullptr, true, {}},
        {"SetQualifier", nullptr, true, {}},
        {"DeleteQualifier", nullptr, true, {}},
    };
    return table;
}

const Row* findRow(const std::string& name) {
    const auto found =
        std::find_if(rows().begin(), rows().end(), [&](const Row& row) { return om::sameName(row.name, name); });
    return found == rows().end() ? nullptr : &*found;
}

bool isNamed(const NameSpace& space, const std::string& name) {
    return om::sameName(space.name, name) ||
           std::any_of(space.aliases.begin(), space.aliases.end(),
                       [&](const std::string& alias) { return om::sameName(alias, name); });
}

void expectRight(const Caller& caller, bool changes) {
    if (!caller.mayRead && !caller.mayChange) fail(CMPI_RC_ERR_ACCESS_DENIED, "");
    if (changes && !caller.mayChange) fail(CMPI_RC_ERR_ACCESS_DENIED, "only administrators may change something");
}

Outcome begun(cimxml::Pieces message, int code, std::size_t enough) {
    std::string room;
    room.reserve(usualMessage);
    cimxml::Writer writer(std::move(room));
    message.writeTo(writer, enough);
    return {writer.take(), std::move(message), code};
}

} // namespace

bool changesSomething(const cimxml::Request& request) {
    if (!request.intrinsic) return true;
    const Row* row = findRow(request.name);
    return row != nullptr && row->changes;
}

Operations::Operations(std::vector<NameSpace> spaces, std::string host)
    : nameSpaces(std::move(spaces)), hostName(std::move(host)) {}

// The checks come in the order of the standard's precedence of errors.
cimxml::Pieces Operations::content(const cimxml::Request& request, const Caller& caller) {
    const Row* row = request.intrinsic ? findRow(request.name) : nullptr;
    expectRight(caller, changesSomething(request));
    if (request.intrinsic && (row == nullptr || row->run == nullptr)) {
        fail(CMPI_RC_ERR_NOT_SUPPORTED, request.name + " is not supported");
    }
    const auto space = std::find_if(nameSpaces.begin(), nameSpaces.end(),
                                    [&](const NameSpace& each) { return isNamed(each, request.nameSpace); });
    if (space == nameSpaces.end()) {
        fail(CMPI_RC_ERR_INVALID_NAMESPACE, "there is no namespace " + request.nameSpace);
    }
    static const std::vector<cimxml::ParameterElement> none;
    static const Names noNames;
    const Parameters parameters(request.intrinsic ? request.parameters : none,
                                row != nullptr ? row->parameters : noNames);
    const Call call{request, parameters, *space, caller, hostName, contexts};
    return row != nullptr ? row->run(call) : invokeMethod(call);
}

Outcome Operations::answer(const cimxml::Request& request, const Caller& caller, std::size_t enough) {
    try {
        return begun(cimxml::response(request, content(request, caller)), CMPI_RC_OK, enough);
    } catch (const cimxml::CimError& error) {
        return begun(cimxml::errorResponse(request, error.code, error.what()), error.code, enough);
    } catch (const std::exception& error) {
        return begun(cimxml::errorResponse(request, CMPI_RC_ERR_FAILED, error.what()), CMPI_RC_ERR_FAILED, enough);
    }
}

} // namespace endpoint
