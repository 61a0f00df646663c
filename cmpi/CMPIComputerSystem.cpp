#include "cmpi/CMPIComputerSystem.h"

namespace VK::BaseServerProvider {

static const std::string& loggerCMPIComputerSystem = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIComputerSystem, "CMPIComputerSystem"};

const TraceSource& CMPIComputerSystem::traceSource() {
    return source;
}

} // namespace VK::BaseServerProvider
