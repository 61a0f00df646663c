#include "cmpi/CMPIComputerSystem.h"

namespace VK::BaseServerProvider {

static const std::string loggerCMPIComputerSystem("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIComputerSystem, "CMPIComputerSystem"};

using Data = ComputerSystem;

const TraceSource& CMPIComputerSystem::traceSource() {
    return source;
}

const Key<Data> CMPIComputerSystem::keys[] = {
    {"CreationClassName", &Data::getCreationClassName},
    {"Name", &Data::getName},
};

const KeyFilter<Data> CMPIComputerSystem::keyFilters[] = {
    {"Name", "name", Data::FilterType::Name},
};

const Property<Data> CMPIComputerSystem::properties[] = {
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
    {"OtherIdentifyingInfo", &Data::getOtherIdentifyingInfo},
    {"IdentifyingDescriptions", &Data::getIdentifyingDescriptions},
    {"NameFormat", &Data::getNameFormat},
    {"Dedicated", &Data::getDedicated},
    {"OtherDedicatedDescriptions", &Data::getOtherDedicatedDescriptions},
    {"ResetCapability", &Data::getResetCapability},
    {"UUID", &Data::getUUID},
    {"Status", &Data::getStatus},
};

} // namespace VK::BaseServerProvider
