#include "Linux/ServiceAffectsElement.h"

#include "Linux/HostName.h"
#include "include/Trace.h"

namespace VK::BaseServerProvider {

static const std::string loggerTimeServiceAffectsElement("Norvane.BaseServerProvider");
static const TraceSource source{loggerTimeServiceAffectsElement, "ServiceAffectsElement"};

TimeServiceAffectsElement::TimeServiceAffectsElement() {
    const TraceScope scope(source);
    hostName = HostName().text();
}

TimeServiceAffectsElement::~TimeServiceAffectsElement() noexcept(false) {
    const DestructorTraceScope scope(source);
}

Moniker TimeServiceAffectsElement::getTimeMoniker(Moniker& computerMoniker) const {
    const ParameterTraceScope scope(source, " computerMoniker=", &computerMoniker);
    Moniker moniker;
    moniker.addKey("SystemName", hostName);
    return moniker;
}

Moniker TimeServiceAffectsElement::getComputerMoniker(Moniker& timeMoniker) const {
    const ParameterTraceScope scope(source, " timeMoniker=", &timeMoniker);
    Moniker moniker;
    moniker.addKey("Name", hostName);
    return moniker;
}

} // namespace VK::BaseServerProvider
