#include "provider/BaseServerProvider.h"

namespace VK::BaseServerProvider {

static const std::string& loggerBaseServerProvider = lastingString("Norvane.BaseServerProvider");
const TraceSource frameSource{loggerBaseServerProvider, "BaseServerProvider"};

std::atomic<const CMPIBroker*> broker{nullptr};

namespace {

constexpr int version = 200;

// Members are set in slot order; headers of later levels append slots, which stay null.
CMPIInstanceMIFT instMIFT__ = {
    version,
    version,
    "instanceBaseServerProvider",
    BaseServer_Cleanup,
    BaseServer_EnumInstanceNames,
    BaseServer_EnumInstances,
    BaseServer_GetInstance,
    BaseServer_CreateInstance,
    BaseServer_ModifyInstance,
    BaseServer_DeleteInstance,
    BaseServer_ExecQuery,
};

CMPIAssociationMIFT assocMIFT__ = {
    version,
    version,
    "associationBaseServerProvider",
    BaseServer_AssociationCleanup,
    BaseServer_Associators,
    BaseServer_AssociatorNames,
    BaseServer_References,
    BaseServer_ReferenceNames,
};

CMPIMethodMIFT methMIFT__ = {
    version, version, "methodBaseServerProvider", BaseServer_MethodCleanup, BaseServer_InvokeMethod,
};

constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};

} // namespace

// Nothing is held between calls, so that there is nothing to clean up and unloading is never refused.

CMPIStatus BaseServer_Cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
    return ok;
}

CMPIStatus BaseServer_AssociationCleanup(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean) {
    return ok;
}

CMPIStatus BaseServer_MethodCleanup(CMPIMethodMI*, const CMPIContext*, CMPIBoolean) {
    return ok;
}

} // namespace VK::BaseServerProvider

using namespace VK::BaseServerProvider;

CMPI_EXTERN_C CMPIInstanceMI* BaseServerProvider_Create_InstanceMI(const CMPIBroker* theBroker, const CMPIContext*,
                                                                   CMPIStatus*) {
    static CMPIInstanceMI mi = {nullptr, &instMIFT__};
    broker = theBroker;
    return &mi;
}

CMPI_EXTERN_C CMPIAssociationMI* BaseServerProvider_Create_AssociationMI(const CMPIBroker* theBroker,
                                                                         const CMPIContext*, CMPIStatus*) {
    static CMPIAssociationMI mi = {nullptr, &assocMIFT__};
    broker = theBroker;
    return &mi;
}

CMPI_EXTERN_C CMPIMethodMI* BaseServerProvider_Create_MethodMI(const CMPIBroker* theBroker, const CMPIContext*,
                                                               CMPIStatus*) {
    static CMPIMethodMI mi = {nullptr, &methMIFT__};
    broker = theBroker;
    return &mi;
}
