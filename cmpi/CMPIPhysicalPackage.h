#pragma once

#include "Linux/PhysicalPackage.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_PhysicalPackage.
class CMPIPhysicalPackage : public InstanceAdapter<CMPIPhysicalPackage, PhysicalPackage> {
public:
    using InstanceAdapter::InstanceAdapter;

    /// Drops all filters and starts again at the first chassis.
    void initialize();

    static constexpr char className[] = "VESKA_PhysicalPackage";
    static constexpr char adapterName[] = "CMPIPhysicalPackage";
    static constexpr char destructorName[] = "~CMPIPhysicalPackage";
    static const TraceSource& traceSource();
    static const Key<PhysicalPackage> keys[2];
    static const KeyFilter<PhysicalPackage> keyFilters[2];
    static const Property<PhysicalPackage> properties[34];
};

} // namespace VK::BaseServerProvider
