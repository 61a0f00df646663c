#include "objectmanager/broker/ObjectManager.h"

#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Invocation.h"
#include "objectmanager/broker/ProviderLibrary.h"

namespace om {

class ObjectManager::Impl {
public:
    Impl(const std::string& file, const std::string& provider, const std::string& nameSpace, const Schema& schema)
        : broker(schema, nameSpace), library(broker, file, provider) {
        broker.provider = &library;
    }

    Broker broker;
    ProviderLibrary library; // goes first: its cleanup functions use the broker
};

ObjectManager::ObjectManager(const std::string& library, const std::string& provider, const std::string& nameSpace,
                             const Schema& schema)
    : impl(std::make_unique<Impl>(library, provider, nameSpace, schema)) {}

ObjectManager::~ObjectManager() = default;

Answer ObjectManager::run(const Request& request, std::chrono::nanoseconds* elapsed) {
    const std::string& nameSpace = request.path.nameSpace.empty() ? impl->broker.nameSpace() : request.path.nameSpace;
    return invoke(impl->broker, request, usualEntries(nameSpace, request.principal), elapsed);
}

const CMPIBroker* ObjectManager::broker() const {
    return impl->broker.handle();
}

CMPIInstanceMI* ObjectManager::instanceMI() {
    return impl->library.instanceMI();
}
CMPIAssociationMI* ObjectManager::associationMI() {
    return impl->library.associationMI();
}
CMPIMethodMI* ObjectManager::methodMI() {
    return impl->library.methodMI();
}

} // namespace om
