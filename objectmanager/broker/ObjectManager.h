#pragma once

#include "objectmanager/broker/Fault.h"
#include "objectmanager/model/Schema.h"
#include "objectmanager/model/Values.h"

#include <cmpift.h>

#include <chrono>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace om {

enum class Operation {
    EnumInstanceNames,
    EnumInstances,
    GetInstance,
    CreateInstance,
    ModifyInstance,
    DeleteInstance,
    ExecQuery,
    Associators,
    AssociatorNames,
    References,
    ReferenceNames,
    InvokeMethod
};

/// One request to a provider. What an operation does not take is ignored.
struct Request {
    Operation operation = Operation::EnumInstanceNames;
    ObjectPath path;
    std::vector<NamedValue> values; ///< properties for create and modify, in arguments for invoke
    std::optional<std::vector<std::string>> propertyList;
    std::optional<std::string> assocClass;
    std::optional<std::string> resultClass;
    std::optional<std::string> role;
    std::optional<std::string> resultRole;
    std::string method;
    std::string query;
    std::string language;
    std::string principal;      ///< who asks, for the provider; empty for nobody in particular
    std::optional<Fault> fault; ///< its calls are counted anew for every request
    CallObserver onCall;        ///< receives the broker's calls, for tests; `vkcim` has no option for it
};

/// A library that cannot be loaded, or a factory function that is missing, fails or returns null.
class LoadError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// The embedded object manager: one provider library, the broker it is given, and the calls into it.
class ObjectManager {
public:
    /// Loads `library` with dlopen; `provider` is the prefix of its factory functions. Throws LoadError when the
    /// library cannot be loaded. A factory function is called when the first operation needs it.
    ObjectManager(const std::string& library, const std::string& provider, const std::string& nameSpace,
                  const Schema& schema = Schema::builtin());
    /// Calls the cleanup functions of the interfaces that were made (terminating), and unloads the library.
    ~ObjectManager();
    ObjectManager(const ObjectManager&) = delete;
    ObjectManager& operator=(const ObjectManager&) = delete;

    /// Runs one operation and gives back all that the provider answered; objects of the call are freed when it ends.
    /// `elapsed` receives the time spent in the provider's function alone. May be called from several threads at
    /// once. Throws LoadError when the interface that the operation needs cannot be made.
    Answer run(const Request& request, std::chrono::nanoseconds* elapsed = nullptr);

    /// The broker handed to the provider.
    const CMPIBroker* broker() const;
    /// The provider's interfaces, made when first asked for; throws LoadError.
    CMPIInstanceMI* instanceMI();
    CMPIAssociationMI* associationMI();
    CMPIMethodMI* methodMI();

private:
    class Impl;
    std::unique_ptr<Impl> impl;
};

} // namespace om
