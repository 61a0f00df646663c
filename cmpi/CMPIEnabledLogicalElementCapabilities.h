#pragma once

#include "Linux/EnabledLogicalElementCapabilities.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_EnabledLogicalElementCapabilities.
class CMPIEnabledLogicalElementCapabilities
    : public InstanceAdapter<CMPIEnabledLogicalElementCapabilities, EnabledLogicalElementCapabilities> {
public:
    using InstanceAdapter::InstanceAdapter;
    using Data = EnabledLogicalElementCapabilities;

    /// Drops all filters and starts again at the first element.
    void initialize();

    static constexpr char className[] = "VESKA_EnabledLogicalElementCapabilities";
    static constexpr char adapterName[] = "CMPIEnabledLogicalElementCapabilities";
    static constexpr char destructorName[] = "~CMPIEnabledLogicalElementCapabilities";
    static const TraceSource& traceSource();

    static constexpr Key<Data> keys[] = {
        {"InstanceID", &Data::getInstanceID},
    };

    static constexpr KeyFilter<Data> keyFilters[] = {
        {"InstanceID", "instanceId", Data::FilterType::InstanceID},
    };

    static constexpr Property<Data> properties[] = {
        {"InstanceID", &Data::getInstanceID},
        {"ElementName", &Data::getElementName},
        {"ElementNameEditSupported", &Data::getElementNameEditSupported},
        {"MaxElementNameLen", &Data::getMaxElementNameLen},
        {"RequestedStatesSupported", &Data::getRequestedStatesSupported},
        {"ElementNameMask", &Data::getElementNameMask},
        {"StateAwareness", &Data::getStateAwareness},
    };
};

} // namespace VK::BaseServerProvider
