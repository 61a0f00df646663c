#pragma once

#include "Linux/EnabledLogicalElementCapabilities.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_EnabledLogicalElementCapabilities.
class CMPIEnabledLogicalElementCapabilities
    : public InstanceAdapter<CMPIEnabledLogicalElementCapabilities, EnabledLogicalElementCapabilities> {
public:
    using InstanceAdapter::InstanceAdapter;

    /// Drops all filters and starts again at the first element.
    void initialize();

    static constexpr char className[] = "VESKA_EnabledLogicalElementCapabilities";
    static constexpr char adapterName[] = "CMPIEnabledLogicalElementCapabilities";
    static constexpr char destructorName[] = "~CMPIEnabledLogicalElementCapabilities";
    static const TraceSource& traceSource();
    static const Key<EnabledLogicalElementCapabilities> keys[1];
    static const KeyFilter<EnabledLogicalElementCapabilities> keyFilters[1];
    static const Property<EnabledLogicalElementCapabilities> properties[7];
};

} // namespace VK::BaseServerProvider
