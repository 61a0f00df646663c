// A provider that breaks the rule that no C++ exception leaves it.
#include <cmpift.h>

#include <stdexcept>

namespace {

CMPIStatus enumerateInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                              const char**) {
    throw std::runtime_error("from the provider");
}

CMPIStatus cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
    throw 1;
}

} // namespace

CMPI_EXTERN_C CMPIInstanceMI* Throwing_Create_InstanceMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*) {
    static CMPIInstanceMIFT table{};
    static CMPIInstanceMI mi{nullptr, &table};
    table.ftVersion = CMPIVersion100;
    table.cleanup = cleanup;
    table.enumerateInstances = enumerateInstances;
    return &mi;
}

CMPI_EXTERN_C CMPIMethodMI* Throwing_Create_MethodMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*) {
    throw 1;
}
