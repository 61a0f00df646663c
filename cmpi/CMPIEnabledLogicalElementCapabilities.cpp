#include "cmpi/CMPIEnabledLogicalElementCapabilities.h"

namespace VK::BaseServerProvider {

static const std::string& loggerCMPIEnabledLogicalElementCapabilities = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIEnabledLogicalElementCapabilities, "CMPIEnabledLogicalElementCapabilities"};

const TraceSource& CMPIEnabledLogicalElementCapabilities::traceSource() {
    return source;
}

void CMPIEnabledLogicalElementCapabilities::initialize() {
    traceMethod(VK_METHOD(source));
    data.initialize();
}

} // namespace VK::BaseServerProvider
