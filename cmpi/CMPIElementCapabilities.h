#pragma once

#include "Linux/ElementCapabilities.h"
#include "cmpi/CMPIEnabledLogicalElementCapabilities.h"
#include "cmpi/NodeAssociationAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_ComputerCapabilities, from a computer system to its capabilities.
class CMPIElementCapabilities
    : public NodeAssociationAdapter<CMPIElementCapabilities, CMPIEnabledLogicalElementCapabilities,
                                    ElementCapabilities> {
public:
    using NodeAssociationAdapter::NodeAssociationAdapter;

    /// The path of a computer's capabilities, of a capabilities' computer; keyless for a keyless path.
    CMPIObjectPath* locateCapabilities(const CMPIObjectPath* objectPath);
    CMPIObjectPath* locateComputer(const CMPIObjectPath* objectPath);
    CMPIObjectPath* locatePartner(const CMPIObjectPath* objectPath) { return locateCapabilities(objectPath); }

    static constexpr char className[] = "VESKA_ComputerCapabilities";
    static constexpr char adapterName[] = "CMPIElementCapabilities";
    static constexpr char destructorName[] = "~CMPIElementCapabilities";
    static constexpr ClassId associationClassId = ClassId::ComputerCapabilities;
    static constexpr ClassId partnerClassId = ClassId::EnabledLogicalElementCapabilities;
    static constexpr char computerRole[] = "ManagedElement";
    static constexpr char partnerRole[] = "Capabilities";
    static constexpr const char* roles[] = {computerRole, partnerRole};
    static const TraceSource& traceSource();
};

} // namespace VK::BaseServerProvider
