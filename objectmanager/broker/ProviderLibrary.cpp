#include "objectmanager/broker/ProviderLibrary.h"

#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/String.h"

#include <dlfcn.h>

namespace om {

namespace {

/// A library without a path is looked for as the loader does.
void* openLibrary(const std::string& file) {
    void* library = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (library == nullptr) throw LoadError(dlerror());
    return library;
}

ContextObject& newContext(Broker& broker) {
    return make<ContextObject>(broker, usualEntries(broker.nameSpace()));
}

} // namespace

ProviderLibrary::ProviderLibrary(Broker& owner, const std::string& file, std::string provider)
    : broker(owner), prefix(std::move(provider)), library(openLibrary(file)) {}

ProviderLibrary::~ProviderLibrary() {
    cleanUp(instance);
    cleanUp(association);
    cleanUp(method);
    dlclose(library);
}

template <class MI>
MI* ProviderLibrary::get(Interface<MI>& interface, const char* kind) {
    if (MI* made = interface.made.load(std::memory_order_acquire)) return made;
    const std::lock_guard lock(mutex);
    if (MI* made = interface.made.load(std::memory_order_relaxed)) return made;
    if (!interface.error.empty()) throw LoadError(interface.error);
    try {
        MI* made = create<MI>(kind);
        interface.made.store(made, std::memory_order_release);
        return made;
    } catch (const LoadError& error) {
        interface.error = error.what();
        throw;
    }
}

template <class MI>
MI* ProviderLibrary::create(const char* kind) {
    using Factory = MI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
    const std::string name = prefix + "_Create_" + kind + "MI";
    const auto factory = reinterpret_cast<Factory>(dlsym(library, name.c_str()));
    if (factory == nullptr) throw LoadError("the library has no function " + name);

    const Call call;
    CMPIStatus made = status(CMPI_RC_OK); // factories made from the usual macros never write it
    MI* mi = nullptr;
    try {
        mi = factory(broker.handle(), &newContext(broker), &made);
    } catch (const std::exception& error) {
        throw LoadError(name + " threw: " + error.what());
    } catch (...) {
        throw LoadError(name + " threw an exception");
    }
    if (made.rc != CMPI_RC_OK) {
        const std::string text = isValid<StringObject>(made.msg) ? ": " + open<StringObject>(made.msg).text() : "";
        throw LoadError(name + " failed with status " + std::to_string(made.rc) + text);
    }
    if (mi == nullptr || mi->ft == nullptr) throw LoadError(name + " returned null");
    if (mi->ft->ftVersion < CMPIVersion100) {
        throw LoadError(name + " made an interface of version " + std::to_string(mi->ft->ftVersion));
    }
    return mi;
}

template <class MI>
void ProviderLibrary::cleanUp(Interface<MI>& interface) {
    MI* mi = interface.made.load(std::memory_order_acquire);
    if (mi == nullptr || mi->ft->cleanup == nullptr) return;
    try {
        const Call call;
        const CMPIBoolean terminating = 1;
        mi->ft->cleanup(mi, &newContext(broker), terminating);
    } catch (...) { // the library is unloaded all the same
    }
}

template CMPIInstanceMI* ProviderLibrary::get(Interface<CMPIInstanceMI>&, const char*);
template CMPIAssociationMI* ProviderLibrary::get(Interface<CMPIAssociationMI>&, const char*);
template CMPIMethodMI* ProviderLibrary::get(Interface<CMPIMethodMI>&, const char*);

} // namespace om
