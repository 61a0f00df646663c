#include "cmpi/CMPIElementCapabilities.h"

namespace VK::BaseServerProvider {

static const std::string& loggerCMPIElementCapabilities = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIElementCapabilities, "CMPIElementCapabilities"};

const TraceSource& CMPIElementCapabilities::traceSource() {
    return source;
}

CMPIObjectPath* CMPIElementCapabilities::locateCapabilities(const CMPIObjectPath* objectPath) {
    const ParameterTraceScope scope(VK_SCOPE(source), " objectPath=", objectPath);
    return locate(CMPIEnabledLogicalElementCapabilities::className, objectPath,
                  [this](Moniker& moniker) { ends.getCapabilitiesMoniker(moniker); });
}

CMPIObjectPath* CMPIElementCapabilities::locateComputer(const CMPIObjectPath* objectPath) {
    const ParameterTraceScope scope(VK_SCOPE(source), " objectPath=", objectPath);
    return locate(CMPIComputerSystem::className, objectPath,
                  [this](Moniker& moniker) { ends.getComputerMoniker(moniker); });
}

} // namespace VK::BaseServerProvider
