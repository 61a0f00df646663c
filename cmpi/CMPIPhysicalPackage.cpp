#include "cmpi/CMPIPhysicalPackage.h"

namespace VK::BaseServerProvider {

static const std::string& loggerCMPIPhysicalPackage = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIPhysicalPackage, "CMPIPhysicalPackage"};

const TraceSource& CMPIPhysicalPackage::traceSource() {
    return source;
}

void CMPIPhysicalPackage::initialize() {
    traceMethod(VK_METHOD(source));
    data.initialize();
}

} // namespace VK::BaseServerProvider
