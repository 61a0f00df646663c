#include "objectmanager/broker/Invocation.h"

#include "objectmanager/broker/Args.h"
#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Fault.h"
#include "objectmanager/broker/Instance.h"
#include "objectmanager/broker/ObjectPath.h"
#include "objectmanager/broker/ProviderLibrary.h"
#include "objectmanager/broker/Result.h"
#include "objectmanager/broker/String.h"

namespace om {

namespace {

/// Provider calls within provider calls, on one thread. More would be a provider that calls itself without end.
constexpr int deepestCall = 32;

const char* orNull(const std::optional<std::string>& text) {
    return text ? text->c_str() : nullptr;
}

/// One request in the shape in which a provider's functions take it.
class Invocation {
public:
    Invocation(Broker& owner, const Request& given, std::vector<ContextEntry> entries, Answer& answer)
        : broker(owner), request(given), context(lend<ContextObject>(std::move(entries))),
          result(lend<ResultObject>(request.operation, answer)), path(lend<PathObject>(qualified(request.path))),
          out(lend<ArgsObject>()) {
        if (!request.propertyList) return;
        for (const std::string& name : *request.propertyList) names.push_back(name.c_str());
        names.push_back(nullptr);
    }

    /// Calls the function; one that the provider leaves null is not supported.
    CMPIStatus run(std::chrono::nanoseconds* elapsed);

    ArgsObject& outArguments() { return out; }
    const ResultObject& resultObject() const { return result; }

private:
    template <class T, class... A>
    T& lend(A&&... arguments) {
        return adopted(std::make_unique<T>(broker, std::forward<A>(arguments)...), Owner::Broker);
    }

    ObjectPath qualified(ObjectPath given) const {
        if (given.nameSpace.empty()) given.nameSpace = broker.nameSpace();
        return given;
    }

    const CMPIInstance* instance() { return &lend<InstanceObject>(Instance{path.path, request.values}); }
    const CMPIArgs* in() { return &lend<ArgsObject>(request.values); }
    const char** properties() { return names.empty() ? nullptr : names.data(); }

    CMPIStatus callInstance(CMPIInstanceMI* mi);
    CMPIStatus callAssociation(CMPIAssociationMI* mi);
    CMPIStatus callMethod(CMPIMethodMI* mi);

    /// Calls one function of a table and takes the time, of the function alone.
    template <class MI, class Function, class... A>
    CMPIStatus call(MI* mi, Function function, A... arguments) {
        if (function == nullptr) return status(CMPI_RC_ERR_NOT_SUPPORTED);
        const auto start = std::chrono::steady_clock::now();
        const CMPIStatus answered = function(mi, &context, &result, &path, arguments...);
        time = std::chrono::steady_clock::now() - start;
        return answered;
    }

    Broker& broker;
    const Request& request;
    ContextObject& context;
    ResultObject& result;
    PathObject& path;
    ArgsObject& out;
    std::vector<const char*> names;
    std::chrono::nanoseconds time{0};
};

CMPIStatus Invocation::callInstance(CMPIInstanceMI* mi) {
    const CMPIInstanceMIFT* ft = mi->ft;
    switch (request.operation) {
    case Operation::EnumInstanceNames:
        return call(mi, ft->enumerateInstanceNames);
    case Operation::EnumInstances:
        return call(mi, ft->enumerateInstances, properties());
    case Operation::GetInstance:
        return call(mi, ft->getInstance, properties());
    case Operation::CreateInstance:
        return call(mi, ft->createInstance, instance());
    case Operation::ModifyInstance:
        return call(mi, ft->modifyInstance, instance(), properties());
    case Operation::DeleteInstance:
        return call(mi, ft->deleteInstance);
    default:
        return call(mi, ft->execQuery, request.query.c_str(), request.language.c_str());
    }
}

CMPIStatus Invocation::callAssociation(CMPIAssociationMI* mi) {
    const CMPIAssociationMIFT* ft = mi->ft;
    const char* assocClass = orNull(request.assocClass);
    const char* resultClass = orNull(request.resultClass);
    const char* role = orNull(request.role);
    const char* resultRole = orNull(request.resultRole);
    switch (request.operation) {
    case Operation::Associators:
        return call(mi, ft->associators, assocClass, resultClass, role, resultRole, properties());
    case Operation::AssociatorNames:
        return call(mi, ft->associatorNames, assocClass, resultClass, role, resultRole);
    case Operation::References:
        return call(mi, ft->references, resultClass, role, properties());
    default:
        return call(mi, ft->referenceNames, resultClass, role);
    }
}

CMPIStatus Invocation::callMethod(CMPIMethodMI* mi) {
    CMPIArgs* outHandle = &out;
    return call(mi, mi->ft->invokeMethod, request.method.c_str(), in(), outHandle);
}

CMPIStatus Invocation::run(std::chrono::nanoseconds* elapsed) {
    ProviderLibrary& provider = *broker.provider;
    CMPIStatus answered = status(CMPI_RC_OK);
    switch (request.operation) {
    case Operation::Associators:
    case Operation::AssociatorNames:
    case Operation::References:
    case Operation::ReferenceNames:
        answered = callAssociation(provider.associationMI());
        break;
    case Operation::InvokeMethod:
        answered = callMethod(provider.methodMI());
        break;
    default:
        answered = callInstance(provider.instanceMI());
        break;
    }
    if (elapsed != nullptr) *elapsed = time;
    return answered;
}

/// Providers often leave the message of a good status unset, so that it is looked at only for a bad one.
std::optional<std::string> messageOf(CMPIStatus answered, const ResultObject& result) {
    if (answered.rc == CMPI_RC_OK) return std::nullopt;
    if (isValid<StringObject>(answered.msg)) return open<StringObject>(answered.msg).text();
    return result.errorMessage;
}

} // namespace

// As in a slot, a thread's end is caught by a reference to no object.
__attribute__((no_sanitize("null"))) Answer
invoke(Broker& broker, const Request& request, std::vector<ContextEntry> entries, std::chrono::nanoseconds* elapsed) {
    Answer answer;
    const Call call;
    if (call.depth() > deepestCall) {
        answer.code = CMPI_RC_ERR_FAILED;
        answer.message = "too many calls within calls";
        return answer;
    }
    Invocation invocation(broker, request, std::move(entries), answer);
    CallWatch watch(request.fault, request.onCall);
    try {
        const CMPIStatus answered = invocation.run(elapsed);
        answer.code = answered.rc;
        answer.message = messageOf(answered, invocation.resultObject());
    } catch (const LoadError&) {
        throw;
    } catch (const abi::__forced_unwind&) {
        throw;
    } catch (...) {
        answer.code = CMPI_RC_ERR_FAILED;
        answer.message = "the provider threw an exception";
    }
    answer.faulted = watch.happened();
    answer.out = std::move(invocation.outArguments().values);
    return answer;
}

} // namespace om
