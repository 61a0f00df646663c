#include "objectmanager/broker/Args.h"
#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Convert.h"
#include "objectmanager/broker/Enumeration.h"
#include "objectmanager/broker/Instance.h"
#include "objectmanager/broker/Invocation.h"
#include "objectmanager/broker/ObjectPath.h"
#include "objectmanager/broker/String.h"

#include <algorithm>

namespace om {

namespace {

std::optional<std::string> orNothing(const char* chars) {
    return chars == nullptr ? std::nullopt : std::optional<std::string>(chars);
}

std::optional<std::vector<std::string>> listOf(const char** names) {
    if (names == nullptr) return std::nullopt;
    std::vector<std::string> list;
    for (; *names != nullptr; ++names) list.emplace_back(*names);
    return list;
}

Request requestFor(Operation operation, const CMPIObjectPath* path) {
    Request request;
    request.operation = operation;
    request.path = open<PathObject>(path).path;
    return request;
}

/// A status other than OK is the up-call's; its message is not passed on.
Answer ask(const CMPIBroker* handle, const CMPIContext* context, const Request& request) {
    Broker& broker = open(handle);
    const auto& entries = open<ContextObject>(context).entries;
    if (broker.provider == nullptr) throw Failure{CMPI_RC_ERR_NOT_SUPPORTED};
    try {
        Answer answer = invoke(broker, request, entries);
        if (answer.code != CMPI_RC_OK) throw Failure{answer.code};
        return answer;
    } catch (const LoadError&) {
        throw Failure{CMPI_RC_ERR_NOT_SUPPORTED}; // the provider does not offer operations of that kind
    }
}

Value toValue(ObjectPath path) {
    return {CMPI_ref, std::make_shared<const ObjectPath>(std::move(path))};
}
Value toValue(Instance instance) {
    return {CMPI_instance, std::make_shared<const Instance>(std::move(instance))};
}

CMPIEnumeration* enumerate(const CMPIBroker* handle, const CMPIContext* context, const Request& request,
                           CMPIType type) {
    Answer answer = ask(handle, context, request);
    std::vector<Value> elements;
    elements.reserve(answer.results.size());
    for (auto& result : answer.results) {
        elements.push_back(std::visit([](auto& one) { return toValue(std::move(one)); }, result));
    }
    return &make<EnumerationObject>(open(handle), type, std::move(elements));
}

CMPIEnumeration* enumerateInstanceNames(const CMPIBroker* handle, const CMPIContext* context,
                                        const CMPIObjectPath* path, CMPIStatus*) {
    return enumerate(handle, context, requestFor(Operation::EnumInstanceNames, path), CMPI_ref);
}

CMPIEnumeration* enumerateInstances(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                                    const char** properties, CMPIStatus*) {
    Request request = requestFor(Operation::EnumInstances, path);
    request.propertyList = listOf(properties);
    return enumerate(handle, context, request, CMPI_instance);
}

/// The one instance of a path; without one NOT_FOUND, and more than one is a fault of the provider.
Instance askForInstance(const CMPIBroker* handle, const CMPIContext* context, const Request& request) {
    Answer answer = ask(handle, context, request);
    if (answer.results.empty()) throw Failure{CMPI_RC_ERR_NOT_FOUND};
    if (answer.results.size() > 1) throw Failure{CMPI_RC_ERR_FAILED};
    return std::get<Instance>(std::move(answer.results.front()));
}

CMPIInstance* getInstance(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                          const char** properties, CMPIStatus*) {
    Request request = requestFor(Operation::GetInstance, path);
    request.propertyList = listOf(properties);
    return &make<InstanceObject>(open(handle), askForInstance(handle, context, request));
}

CMPIObjectPath* createInstance(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                               const CMPIInstance* instance, CMPIStatus*) {
    Request request = requestFor(Operation::CreateInstance, path);
    request.values = open<InstanceObject>(instance).value().properties;
    Answer answer = ask(handle, context, request);
    if (answer.results.empty()) throw Failure{CMPI_RC_ERR_FAILED};
    return &make<PathObject>(open(handle), std::get<ObjectPath>(std::move(answer.results.front())));
}

CMPIStatus modifyInstance(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                          const CMPIInstance* instance, const char** properties) {
    Request request = requestFor(Operation::ModifyInstance, path);
    request.values = open<InstanceObject>(instance).value().properties;
    request.propertyList = listOf(properties);
    ask(handle, context, request);
    return status(CMPI_RC_OK);
}

CMPIStatus deleteInstance(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path) {
    ask(handle, context, requestFor(Operation::DeleteInstance, path));
    return status(CMPI_RC_OK);
}

CMPIEnumeration* execQuery(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                           const char* query, const char* language, CMPIStatus*) {
    Request request = requestFor(Operation::ExecQuery, path);
    request.query = text(query);
    request.language = text(language);
    return enumerate(handle, context, request, CMPI_instance);
}

Request associationRequest(Operation operation, const CMPIObjectPath* path, const char* resultClass, const char* role) {
    Request request = requestFor(operation, path);
    request.resultClass = orNothing(resultClass);
    request.role = orNothing(role);
    return request;
}

CMPIEnumeration* associators(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                             const char* assocClass, const char* resultClass, const char* role, const char* resultRole,
                             const char** properties, CMPIStatus*) {
    Request request = associationRequest(Operation::Associators, path, resultClass, role);
    request.assocClass = orNothing(assocClass);
    request.resultRole = orNothing(resultRole);
    request.propertyList = listOf(properties);
    return enumerate(handle, context, request, CMPI_instance);
}

CMPIEnumeration* associatorNames(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                                 const char* assocClass, const char* resultClass, const char* role,
                                 const char* resultRole, CMPIStatus*) {
    Request request = associationRequest(Operation::AssociatorNames, path, resultClass, role);
    request.assocClass = orNothing(assocClass);
    request.resultRole = orNothing(resultRole);
    return enumerate(handle, context, request, CMPI_ref);
}

CMPIEnumeration* references(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                            const char* resultClass, const char* role, const char** properties, CMPIStatus*) {
    Request request = associationRequest(Operation::References, path, resultClass, role);
    request.propertyList = listOf(properties);
    return enumerate(handle, context, request, CMPI_instance);
}

CMPIEnumeration* referenceNames(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                                const char* resultClass, const char* role, CMPIStatus*) {
    return enumerate(handle, context, associationRequest(Operation::ReferenceNames, path, resultClass, role), CMPI_ref);
}

/// A value that belongs to the present call alone.
CMPIData giveAway(Broker& broker, const Value& value) {
    auto& holder = make<ArgsObject>(broker, std::vector<NamedValue>());
    return give(holder, value);
}

CMPIData invokeMethod(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                      const char* method, const CMPIArgs* in, CMPIArgs* out, CMPIStatus*) {
    Request request = requestFor(Operation::InvokeMethod, path);
    request.method = text(method);
    request.values = open<ArgsObject>(in).values;
    auto& target = open<ArgsObject>(out);
    Answer answer = ask(handle, context, request);
    target.values = std::move(answer.out);
    return giveAway(open(handle), answer.returnValue ? std::move(*answer.returnValue) : Value());
}

/// Properties go through whole instances, as providers serve those.
CMPIStatus setProperty(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path,
                       const char* name, const CMPIValue* value, CMPIType type) {
    Request request = requestFor(Operation::ModifyInstance, path);
    request.propertyList = std::vector<std::string>{text(name)};
    InstanceObject instance(open(handle), Instance{request.path, {}});
    instance.set(name, value, type);
    request.values = instance.value().properties;
    ask(handle, context, request);
    return status(CMPI_RC_OK);
}

CMPIData getProperty(const CMPIBroker* handle, const CMPIContext* context, const CMPIObjectPath* path, const char* name,
                     CMPIStatus* rc) {
    Request request = requestFor(Operation::GetInstance, path);
    request.propertyList = std::vector<std::string>{text(name)};
    auto& instance = make<InstanceObject>(open(handle), askForInstance(handle, context, request));
    return giveNamed(instance, instance.value().properties, name, rc);
}

CMPIContext* prepareAttachThread(const CMPIBroker* handle, const CMPIContext* context) {
    return open(handle).prepareAttach(context);
}

CMPIStatus attachThread(const CMPIBroker* handle, const CMPIContext* context) {
    open(handle).attach(context);
    return status(CMPI_RC_OK);
}

CMPIStatus detachThread(const CMPIBroker* handle, const CMPIContext* context) {
    open(handle).detach(context);
    return status(CMPI_RC_OK);
}

CMPIStatus deliverIndication(const CMPIBroker* handle, const CMPIContext*, const char*, const CMPIInstance*) {
    open(handle);
    return status(CMPI_RC_ERR_NOT_SUPPORTED);
}

template <class... Rest>
CMPIEnumeration* noFilters(const CMPIBroker* handle, const CMPIContext*, const CMPIObjectPath*, Rest...) {
    open(handle);
    throw Failure{CMPI_RC_ERR_NOT_SUPPORTED};
}

using Text = const char*;

/// Later headers append these slots; they are filled where they are there.
template <class Table>
constexpr auto fillLater(Table& ft, int) -> decltype(ft.enumerateInstancesFiltered, void()) {
    ft.enumerateInstancesFiltered = Slot<&noFilters<const char**, Text, Text, CMPIStatus*>>();
    ft.associatorsFiltered = Slot<&noFilters<Text, Text, Text, Text, const char**, Text, Text, CMPIStatus*>>();
    ft.referencesFiltered = Slot<&noFilters<Text, Text, const char**, Text, Text, CMPIStatus*>>();
}
template <class Table>
constexpr void fillLater(Table&, long) {}

constexpr void fillAssociations(CMPIBrokerFT& ft) {
    ft.associators = Slot<&associators, FaultKind::associators>();
    ft.associatorNames = Slot<&associatorNames, FaultKind::associatorNames>();
    ft.references = Slot<&references, FaultKind::references>();
    ft.referenceNames = Slot<&referenceNames, FaultKind::referenceNames>();
}

constexpr CMPIBrokerFT makeTable() {
    CMPIBrokerFT ft{};
    ft.brokerCapabilities = CMPI_MB_InstanceManipulation | CMPI_MB_AssociationTraversal | CMPI_MB_QueryExecution |
                            CMPI_MB_OSEncapsulationSupport | CMPI_MB_Supports_MemEnhancements |
                            CMPI_MB_Supports_Extended_Error;
    ft.brokerVersion = CMPIVersion200;
    ft.brokerName = "Embedded object manager";
    ft.prepareAttachThread = Slot<&prepareAttachThread, FaultKind::prepareAttachThread>();
    ft.attachThread = Slot<&attachThread, FaultKind::attachThread>();
    ft.detachThread = Slot<&detachThread, FaultKind::detachThread>();
    ft.deliverIndication = Slot<&deliverIndication>();
    ft.enumerateInstanceNames = Slot<&enumerateInstanceNames, FaultKind::enumerateInstanceNames>();
    ft.getInstance = Slot<&getInstance, FaultKind::getInstance>();
    ft.createInstance = Slot<&createInstance, FaultKind::createInstance>();
    ft.modifyInstance = Slot<&modifyInstance, FaultKind::modifyInstance>();
    ft.deleteInstance = Slot<&deleteInstance, FaultKind::deleteInstance>();
    ft.execQuery = Slot<&execQuery, FaultKind::execQuery>();
    ft.enumerateInstances = Slot<&enumerateInstances, FaultKind::enumerateInstances>();
    fillAssociations(ft);
    ft.invokeMethod = Slot<&invokeMethod, FaultKind::invokeMethod>();
    ft.setProperty = Slot<&setProperty, FaultKind::setProperty>();
    ft.getProperty = Slot<&getProperty, FaultKind::getProperty>();
    fillLater(ft, 0);
    return ft;
}

} // namespace

const CMPIBrokerFT upCallTable = makeTable();

} // namespace om
