#pragma once

#include "Linux/ComputerSystem.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_ComputerSystem.
class CMPIComputerSystem : public InstanceAdapter<CMPIComputerSystem, ComputerSystem> {
public:
    using InstanceAdapter::InstanceAdapter;
    using Data = ComputerSystem;

    static constexpr char className[] = "VESKA_ComputerSystem";
    static constexpr char adapterName[] = "CMPIComputerSystem";
    static constexpr char destructorName[] = "~CMPIComputerSystem";
    static const TraceSource& traceSource();

    static constexpr Key<Data> keys[] = {
        {"CreationClassName", &Data::getCreationClassName},
        {"Name", &Data::getName},
    };

    static constexpr KeyFilter<Data> keyFilters[] = {
        {"Name", "name", Data::FilterType::Name},
    };

    static constexpr Property<Data> properties[] = {
        {"Caption", &Data::getCaption},
        {"Description", &Data::getDescription},
        {"ElementName", &Data::getElementName},
        {"InstallDate", &Data::getInstallDate, dateTime},
        {"OperationalStatus", &Data::getOperationalStatus},
        {"StatusDescriptions", &Data::getStatusDescriptions},
        {"HealthState", &Data::getHealthState},
        {"PrimaryStatus", &Data::getPrimaryStatus},
        {"DetailedStatus", &Data::getDetailedStatus},
        {"OperatingStatus", &Data::getOperatingStatus},
        {"CommunicationStatus", &Data::getCommunicationStatus},
        {"EnabledState", &Data::getEnabledState},
        {"OtherEnabledState", &Data::getOtherEnabledState},
        {"RequestedState", &Data::getRequestedState},
        {"EnabledDefault", &Data::getEnabledDefault},
        {"TimeOfLastStateChange", &Data::getTimeOfLastStateChange, dateTime},
        {"AvailableRequestedStates", &Data::getAvailableRequestedStates},
        {"TransitioningToState", &Data::getTransitioningToState},
        {"CreationClassName", &Data::getCreationClassName},
        {"Name", &Data::getName},
        {"PrimaryOwnerName", &Data::getPrimaryOwnerName},
        {"PrimaryOwnerContact", &Data::getPrimaryOwnerContact},
        {"OtherIdentifyingInfo", &Data::supplyOtherIdentifyingInfo},
        {"IdentifyingDescriptions", &Data::supplyIdentifyingDescriptions},
        {"NameFormat", &Data::getNameFormat},
        {"Dedicated", &Data::getDedicated},
        {"OtherDedicatedDescriptions", &Data::getOtherDedicatedDescriptions},
        {"ResetCapability", &Data::getResetCapability},
        {"UUID", &Data::getUUID},
        {"Status", &Data::getStatus},
    };
};

} // namespace VK::BaseServerProvider
