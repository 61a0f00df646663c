#pragma once

#include "Linux/ServiceAffectsElement.h"
#include "cmpi/AssociationAdapter.h"
#include "cmpi/CMPITimeService.h"

namespace VK::BaseServerProvider {

/// VESKA_TimeServiceAffectsElement, from the time service to the computer system. The keys of an association's path are
/// not looked at: the association is always this host's.
class CMPITimeServiceAffectsElement
    : public AssociationAdapter<CMPITimeServiceAffectsElement, CMPITimeService, TimeServiceAffectsElement> {
public:
    CMPITimeServiceAffectsElement(const CMPIBroker* theBroker, const CMPIContext* context,
                                  const CMPIObjectPath* objectPath);
    ~CMPITimeServiceAffectsElement() noexcept(false);

    /// Whether there is an element at the other end from the request's; for the association, whether both ends stand.
    explicit operator bool() const;
    /// Moves on at the other end; for the association at both ends in step, so that there is one pair.
    CMPITimeServiceAffectsElement& operator++();

    /// False when the broker refused the path that chooses the other end; writes no line.
    bool hasPair() const { return narrowed; }

    /// The path of a computer's time service, of a time service's computer; keyless for a keyless path.
    CMPIObjectPath* locateTimeService(const CMPIObjectPath* objectPath);
    CMPIObjectPath* locateComputer(const CMPIObjectPath* objectPath);

    static constexpr char className[] = "VESKA_TimeServiceAffectsElement";
    static constexpr ClassId associationClassId = ClassId::TimeServiceAffectsElement;
    static constexpr ClassId partnerClassId = ClassId::TimeService;
    static constexpr char computerRole[] = "AffectedElement";
    static constexpr char partnerRole[] = "AffectingElement";
    static constexpr const char* roles[] = {computerRole, partnerRole};
    static const TraceSource& traceSource();

private:
    /// The scope is that of the whole constructor: its entry line stands before those of the members.
    CMPITimeServiceAffectsElement(const CMPIBroker* theBroker, const CMPIContext* context,
                                  const CMPIObjectPath* objectPath, const ParameterTraceScope&);

    bool narrowed = true;
};

} // namespace VK::BaseServerProvider
