// Single operations of the product's libraries that fail; preloaded, so that they stand before the real ones.
#include "vk/Instrumentation.h"
#include "vk/ProviderUtilities.h"

#include "Environment.h"

#include <dlfcn.h>

namespace {

/// The operation that this one stands before. The library that holds it is loaded by now, but not for everybody.
template <class Function>
Function real(const char* library, const char* symbol) {
    void* const handle = dlopen(library, RTLD_LAZY | RTLD_NOLOAD);
    if (handle == nullptr) std::abort();
    return reinterpret_cast<Function>(dlsym(handle, symbol));
}

constexpr char utilities[] = "libvkproviderutilities.so.1";
constexpr char instrumentation[] = "libvkinstrumentation.so.1";

} // namespace

namespace VK {

unsigned int ProviderUtilities::getKeyCount(const CMPIObjectPath* objectPath) {
    replacement::failIn("getKeyCount");
    return real<unsigned int (*)(const CMPIObjectPath*)>(
        utilities, "_ZN2VK17ProviderUtilities11getKeyCountEPK15_CMPIObjectPath")(objectPath);
}

CMPIInstance* ProviderUtilities::createInstance(const CMPIBroker* broker, CMPIObjectPath* objectPath) {
    replacement::failIn("createInstance");
    return real<CMPIInstance* (*)(const CMPIBroker*, CMPIObjectPath*)>(
        utilities, "_ZN2VK17ProviderUtilities14createInstanceEPK11_CMPIBrokerP15_CMPIObjectPath")(broker, objectPath);
}

unsigned int Instrumentation::getNodeStatus() const {
    replacement::failIn("getNodeStatus");
    return real<unsigned int (*)(const Instrumentation*)>(instrumentation,
                                                          "_ZNK2VK15Instrumentation13getNodeStatusEv")(this);
}

bool Instrumentation::setProperty(NodeLexicon::Properties property, unsigned int& value) {
    replacement::failIn("setProperty");
    return real<bool (*)(Instrumentation*, NodeLexicon::Properties, unsigned int&)>(
        instrumentation, "_ZN2VK15Instrumentation11setPropertyENS_11NodeLexicon10PropertiesERj")(this, property, value);
}

} // namespace VK
