#include "cmpi/CMPIEnabledLogicalElementCapabilities.h"

namespace VK::BaseServerProvider {

static const std::string loggerCMPIEnabledLogicalElementCapabilities("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIEnabledLogicalElementCapabilities, "CMPIEnabledLogicalElementCapabilities"};

using Data = EnabledLogicalElementCapabilities;

const TraceSource& CMPIEnabledLogicalElementCapabilities::traceSource() {
    return source;
}

const Key<Data> CMPIEnabledLogicalElementCapabilities::keys[] = {
    {"InstanceID", &Data::getInstanceID},
};

const KeyFilter<Data> CMPIEnabledLogicalElementCapabilities::keyFilters[] = {
    {"InstanceID", "instanceId", Data::FilterType::InstanceID},
};

const Property<Data> CMPIEnabledLogicalElementCapabilities::properties[] = {
    {"InstanceID", &Data::getInstanceID},
    {"ElementName", &Data::getElementName},
    {"ElementNameEditSupported", &Data::getElementNameEditSupported},
    {"MaxElementNameLen", &Data::getMaxElementNameLen},
    {"RequestedStatesSupported", &Data::getRequestedStatesSupported},
    {"ElementNameMask", &Data::getElementNameMask},
    {"StateAwareness", &Data::getStateAwareness},
};

void CMPIEnabledLogicalElementCapabilities::initialize() {
    traceMethod(source);
    data.initialize();
}

} // namespace VK::BaseServerProvider
