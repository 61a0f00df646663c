#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <atomic>
#include <mutex>
#include <string>

namespace om {

class Broker;

/// A provider's shared library and the interfaces it makes, one of each kind, made when first asked for.
class ProviderLibrary {
public:
    /// Throws LoadError.
    ProviderLibrary(Broker& broker, const std::string& file, std::string provider);
    /// Calls the cleanup functions of the interfaces that were made, and unloads the library.
    ~ProviderLibrary();
    ProviderLibrary(const ProviderLibrary&) = delete;
    ProviderLibrary& operator=(const ProviderLibrary&) = delete;

    /// Throw LoadError where the factory function is missing, fails or returns nothing usable.
    CMPIInstanceMI* instanceMI() { return get(instance, "Instance"); }
    CMPIAssociationMI* associationMI() { return get(association, "Association"); }
    CMPIMethodMI* methodMI() { return get(method, "Method"); }

private:
    template <class MI>
    struct Interface {
        std::atomic<MI*> made{nullptr};
        std::string error; ///< why it could not be made; not tried again
    };

    template <class MI>
    MI* get(Interface<MI>& interface, const char* kind);
    template <class MI>
    MI* create(const char* kind);
    template <class MI>
    void cleanUp(Interface<MI>& interface);

    Broker& broker;
    std::string prefix;
    void* library;
    std::mutex mutex; // of making
    Interface<CMPIInstanceMI> instance;
    Interface<CMPIAssociationMI> association;
    Interface<CMPIMethodMI> method;
};

} // namespace om
