#pragma once

#include "Linux/ComputerSystem.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_ComputerSystem.
class CMPIComputerSystem : public InstanceAdapter<CMPIComputerSystem, ComputerSystem> {
public:
    using InstanceAdapter::InstanceAdapter;

    static constexpr char className[] = "VESKA_ComputerSystem";
    static constexpr char adapterName[] = "CMPIComputerSystem";
    static constexpr char destructorName[] = "~CMPIComputerSystem";
    static const TraceSource& traceSource();
    static const Key<ComputerSystem> keys[2];
    static const KeyFilter<ComputerSystem> keyFilters[1];
    static const Property<ComputerSystem> properties[30];
};

} // namespace VK::BaseServerProvider
