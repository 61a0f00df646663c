#include "objectmanager/endpoint/Operations.h"
#include "objectmanager/endpoint/Results.h"

#include <algorithm>

namespace endpoint {
namespace {

using Kind = cimxml::ValueElement::Kind;

/// The path of an instance that a provider serves. The path has to name the class that made it.
om::ObjectPath servedPath(const Call& call, const cimxml::PathElement& element) {
    om::ObjectPath path = typedPath(call, element);
    if (!isServed(call, path.className)) fail(CMPI_RC_ERR_NOT_FOUND, "");
    return path;
}

/// All that the providers of the class and its subclasses return, without what is of no such class.
template <class Result>
std::vector<Result> resultsBelow(const Call& call, const std::string& className, om::Operation operation,
                                 const std::optional<std::vector<std::string>>& properties) {
    std::vector<om::Request> requests;
    for (const std::string& served : call.schema().servedBelow(className)) {
        requests.push_back(requestFor(call, operation, served));
        requests.back().propertyList = properties;
    }
    return wantedResults<Result>(call, requests, [&](std::size_t, const om::ObjectPath& path) {
        return call.schema().isA(path.className, className);
    });
}

/// The instance of a path; NOT_FOUND where the provider returned none. A path that lacks a key is taken only where
/// the instance lacks it, too: some elements have no value for one.
om::Instance fetch(const Call& call, const om::ObjectPath& path,
                   const std::optional<std::vector<std::string>>& properties) {
    if (path.keys.empty()) expectAllKeys(call, path);
    om::Request request = requestFor(call, om::Operation::GetInstance, path);
    request.propertyList = properties;
    om::Answer answer = ask(call, request);
    if (answer.results.empty()) fail(CMPI_RC_ERR_NOT_FOUND, "");
    auto instance = std::get<om::Instance>(std::move(answer.results.front()));
    if (instance.path.keys.size() > path.keys.size()) expectAllKeys(call, path);
    return instance;
}

const om::PropertyDeclaration& declaredProperty(const Call& call, const om::ObjectPath& path, const std::string& name) {
    const om::PropertyDeclaration* declared = call.schema().findProperty(path.className, name);
    if (declared == nullptr) fail(CMPI_RC_ERR_NO_SUCH_PROPERTY, path.className + " has no property " + name);
    return *declared;
}

/// What a modification carries to the provider: the properties asked for, or all that have a value. Clients send whole
/// instances back, of which they changed one property.
std::vector<om::NamedValue> changedValues(const om::Instance& instance,
                                          const std::optional<std::vector<std::string>>& list) {
    std::vector<om::NamedValue> values;
    for (const om::NamedValue& property : instance.properties) {
        const bool listed = list && om::containsName(*list, property.first);
        if (listed || (!list && !property.second.isNull())) values.push_back(property);
    }
    return values;
}

om::Instance typedNew(const Call& call, const cimxml::InstanceElement& element) {
    for (const cimxml::PropertyElement& property : element.properties) {
        om::ObjectPath path;
        path.className = element.className;
        declaredProperty(call, path, property.name);
    }
    return cimxml::typedInstance(element, call.reading());
}

} // namespace

std::vector<om::Instance> instancesOfClass(const Call& call, Selection& selection) {
    const std::string className = call.parameters.requiredClassName("ClassName");
    const om::ResolvedClass& known = knownClass(call, className);
    if (!call.parameters.flag("DeepInheritance", true)) selection.limitTo(known);
    auto found = resultsBelow<om::Instance>(call, className, om::Operation::EnumInstances, selection.properties());
    for (om::Instance& instance : found) instance = selection.of(std::move(instance));
    return found;
}

std::vector<om::ObjectPath> pathsOfClass(const Call& call) {
    const std::string className = call.parameters.requiredClassName("ClassName");
    knownClass(call, className);
    return resultsBelow<om::ObjectPath>(call, className, om::Operation::EnumInstanceNames, std::nullopt);
}

cimxml::Pieces getInstance(const Call& call) {
    const Selection selection(call);
    const om::ObjectPath path = servedPath(call, call.parameters.requiredInstanceName("InstanceName"));
    cimxml::Writer writer;
    selection.write(writer, selection.of(fetch(call, path, selection.properties())));
    return returned(writer.take());
}

cimxml::Pieces enumerateInstances(const Call& call) {
    Selection selection(call);
    std::vector<om::Instance> instances = instancesOfClass(call, selection);
    const auto write = [selection](cimxml::Writer& writer, const om::Instance& instance) {
        writer.open("VALUE.NAMEDINSTANCE");
        writer.instanceName(instance.path);
        selection.write(writer, instance);
        writer.close("VALUE.NAMEDINSTANCE");
    };
    return returned(cimxml::Pieces(cimxml::oneByOne(std::move(instances), write)));
}

cimxml::Pieces enumerateInstanceNames(const Call& call) {
    const auto write = [](cimxml::Writer& writer, const om::ObjectPath& path) { writer.instanceName(path); };
    return returned(cimxml::Pieces(cimxml::oneByOne(pathsOfClass(call), write)));
}

cimxml::Pieces createInstance(const Call& call) {
    const cimxml::InstanceElement& element = *call.parameters.required("NewInstance", Kind::Instance).instance;
    const om::ResolvedClass& known = knownClass(call, element.className);
    if (!isServed(call, element.className)) fail(CMPI_RC_ERR_NOT_SUPPORTED, "");
    om::Instance instance = typedNew(call, element);
    for (const om::PropertyDeclaration* key : known.keys) {
        const om::Value* value = om::findValue(instance.properties, key->name);
        if (value != nullptr && !value->isNull()) instance.path.keys.emplace_back(key->name, *value);
    }
    om::Request request = requestFor(call, om::Operation::CreateInstance, instance.path);
    request.values = std::move(instance.properties);
    const om::Answer answer = ask(call, request);
    if (answer.results.empty()) fail(CMPI_RC_ERR_FAILED, "the provider named no new instance");
    cimxml::Writer writer;
    writer.instanceName(std::get<om::ObjectPath>(answer.results.front()));
    return returned(writer.take());
}

cimxml::Pieces modifyInstance(const Call& call) {
    call.parameters.flag("IncludeQualifiers", true);
    const cimxml::ValueElement& given = call.parameters.required("ModifiedInstance", Kind::NamedInstance);
    const auto list = call.parameters.names("PropertyList");
    const om::ObjectPath path = servedPath(call, *given.path);
    expectAllKeys(call, path);
    if (!om::sameName(given.instance->className, path.className)) {
        fail(CMPI_RC_ERR_INVALID_PARAMETER, "path and instance are of two classes");
    }
    for (const std::string& name : list.value_or(std::vector<std::string>())) declaredProperty(call, path, name);
    om::Request request = requestFor(call, om::Operation::ModifyInstance, path);
    request.values = changedValues(typedNew(call, *given.instance), list);
    request.propertyList = list;
    ask(call, request);
    return {};
}

cimxml::Pieces deleteInstance(const Call& call) {
    const om::ObjectPath path = servedPath(call, call.parameters.requiredInstanceName("InstanceName"));
    expectAllKeys(call, path);
    ask(call, requestFor(call, om::Operation::DeleteInstance, path));
    return {};
}

cimxml::Pieces getProperty(const Call& call) {
    const om::ObjectPath path = servedPath(call, call.parameters.requiredInstanceName("InstanceName"));
    const std::string name = declaredProperty(call, path, call.parameters.requiredText("PropertyName")).name;
    const om::Instance instance = fetch(call, path, std::vector<std::string>{name});
    const om::Value* value = om::findValue(instance.properties, name);
    if (value == nullptr || value->isNull()) return {};
    cimxml::Writer writer;
    writer.value(*value);
    return returned(writer.take());
}

cimxml::Pieces setProperty(const Call& call) {
    const om::ObjectPath path = servedPath(call, call.parameters.requiredInstanceName("InstanceName"));
    expectAllKeys(call, path);
    const std::string name = call.parameters.requiredText("PropertyName");
    const om::PropertyDeclaration& declared = declaredProperty(call, path, name);
    const cimxml::ValueElement* given = call.parameters.find("NewValue");
    om::Request request = requestFor(call, om::Operation::ModifyInstance, path);
    request.propertyList = std::vector<std::string>{declared.name};
    request.values.emplace_back(declared.name, given == nullptr
                                                   ? om::Value{declared.type, {}}
                                                   : cimxml::typedValue(*given, declared.type, call.reading()));
    ask(call, request);
    return {};
}

} // namespace endpoint
