#include "Linux/ServiceAffectsElement.h"

#include "Linux/HostName.h"
#include "include/Trace.h"

namespace VK::BaseServerProvider {

static const std::string& loggerTimeServiceAffectsElement = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerTimeServiceAffectsElement, "ServiceAffectsElement"};

TimeServiceAffectsElement::TimeServiceAffectsElement() {
    const TraceScope scope(VK_SCOPE(source));
    hostName = HostName().text();
}

TimeServiceAffectsElement::~TimeServiceAffectsElement() noexcept(false) {
    const DestructorTraceScope scope(VK_SCOPE(source));
}

Moniker TimeServiceAffectsElement::getTimeMoniker(Moniker& computerMoniker) const {
    const ParameterTraceScope scope(VK_SCOPE(source), " computerMoniker=", &computerMoniker);
    Moniker moniker;
    moniker.addKey("SystemName", hostName);
    return moniker;
}

Moniker TimeServiceAffectsElement::getComputerMoniker(Moniker& timeMoniker) const {
    const ParameterTraceScope scope(VK_SCOPE(source), " timeMoniker=", &timeMoniker);
    Moniker moniker;
    moniker.addKey("Name", hostName);
    return moniker;
}

} // namespace VK::BaseServerProvider
