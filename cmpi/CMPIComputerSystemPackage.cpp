#include "cmpi/CMPIComputerSystemPackage.h"

#include <strings.h>

namespace VK::BaseServerProvider {

static const std::string& loggerCMPIComputerSystemPackage = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIComputerSystemPackage, "CMPIComputerSystemPackage"};

const TraceSource& CMPIComputerSystemPackage::traceSource() {
    return source;
}

CMPIObjectPath* CMPIComputerSystemPackage::locatePhysicalPackage(const CMPIObjectPath* objectPath) {
    const ParameterTraceScope scope(VK_SCOPE(source), " objectPath=", objectPath);
    return locate(CMPIPhysicalPackage::className, objectPath,
                  [this](Moniker& moniker) { ends.getPhysicalPackageMoniker(moniker); });
}

CMPIObjectPath* CMPIComputerSystemPackage::locateComputerSystem(const CMPIObjectPath* objectPath) {
    const ParameterTraceScope scope(VK_SCOPE(source), " objectPath=", objectPath);
    return locate(CMPIComputerSystem::className, objectPath,
                  [this](Moniker& moniker) { ends.getComputerSystemMoniker(moniker); });
}

bool CMPIComputerSystemPackage::isNotTargetClass(const char* resultClass) const {
    const ParameterTraceScope scope(VK_SCOPE(source), " resultClass=", resultClass);
    const auto isNeither = [resultClass](const char* ours, const char* base) {
        return strcasecmp(resultClass, ours) != 0 && strcasecmp(resultClass, base) != 0;
    };
    if (requestedClassId == ClassId::ComputerSystem)
        return isNeither(CMPIPhysicalPackage::className, "CIM_PhysicalPackage");
    if (requestedClassId == partnerClassId) return isNeither(CMPIComputerSystem::className, "CIM_ComputerSystem");
    return true;
}

void CMPIComputerSystemPackage::addProperties(CMPIInstance* instance) {
    std::string guid;
    if (ends.getPlatformGUID(guid)) ProviderUtilities::setProperty(instance, "PlatformGUID", guid);
}

} // namespace VK::BaseServerProvider
