#include "cmpi/CMPIServiceAffectsElement.h"

namespace VK::BaseServerProvider {

static const std::string& loggerCMPITimeServiceAffectsElement = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPITimeServiceAffectsElement, "CMPIServiceAffectsElement"};

const TraceSource& CMPITimeServiceAffectsElement::traceSource() {
    return source;
}

CMPITimeServiceAffectsElement::CMPITimeServiceAffectsElement(const CMPIBroker* theBroker, const CMPIContext* context,
                                                             const CMPIObjectPath* objectPath)
    : CMPITimeServiceAffectsElement(theBroker, context, objectPath,
                                    ParameterTraceScope(VK_SCOPE(source), " _broker=", theBroker, " _context=", context,
                                                        " objectPath=", objectPath)) {}

CMPITimeServiceAffectsElement::CMPITimeServiceAffectsElement(const CMPIBroker* theBroker, const CMPIContext* context,
                                                             const CMPIObjectPath* objectPath,
                                                             const ParameterTraceScope&)
    : AssociationAdapter(theBroker, context, objectPath) {
    traceRequestedClassId(source);
    if (requestedClassId == partnerClassId)
        narrowed = narrow(computer, locateComputer(objectPath));
    else if (requestedClassId == associationClassId) // on purpose: all computers, whatever the path's keys
        narrowed = narrow(computer, keylessPath(CMPIComputerSystem::className));
    else if (requestedClassId == ClassId::ComputerSystem)
        narrowed = narrow(partner, locateTimeService(objectPath));
}

CMPITimeServiceAffectsElement::~CMPITimeServiceAffectsElement() noexcept(false) {
    traceDestructor(VK_METHOD(source));
}

CMPITimeServiceAffectsElement::operator bool() const {
    const TraceScope scope(VK_SCOPE(source));
    if (!narrowed) return false;
    switch (requestedClassId) {
    case partnerClassId:
        return static_cast<bool>(computer);
    case ClassId::ComputerSystem:
        return static_cast<bool>(partner);
    case associationClassId:
        return computer && partner;
    default:
        return false;
    }
}

CMPITimeServiceAffectsElement& CMPITimeServiceAffectsElement::operator++() {
    const TraceScope scope(VK_SCOPE(source));
    if (requestedClassId == ClassId::ComputerSystem || requestedClassId == associationClassId) ++partner;
    if (requestedClassId == partnerClassId || requestedClassId == associationClassId) ++computer;
    return *this;
}

CMPIObjectPath* CMPITimeServiceAffectsElement::locateTimeService(const CMPIObjectPath* objectPath) {
    const ParameterTraceScope scope(VK_SCOPE(source), " objectPath=", objectPath);
    return locate(CMPITimeService::className, objectPath,
                  [this](Moniker& moniker) { moniker = ends.getTimeMoniker(moniker); });
}

CMPIObjectPath* CMPITimeServiceAffectsElement::locateComputer(const CMPIObjectPath* objectPath) {
    const ParameterTraceScope scope(VK_SCOPE(source), " objectPath=", objectPath);
    return locate(CMPIComputerSystem::className, objectPath,
                  [this](Moniker& moniker) { moniker = ends.getComputerMoniker(moniker); });
}

} // namespace VK::BaseServerProvider
