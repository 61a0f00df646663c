#pragma once

#include "Linux/ComputerSystemPackage.h"
#include "cmpi/CMPIPhysicalPackage.h"
#include "cmpi/NodeAssociationAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_ComputerSystemPackage, from a chassis to its computer system.
class CMPIComputerSystemPackage
    : public NodeAssociationAdapter<CMPIComputerSystemPackage, CMPIPhysicalPackage, ComputerSystemPackage> {
public:
    using NodeAssociationAdapter::NodeAssociationAdapter;

    /// The path of a computer's chassis, of a chassis' computer; keyless for a keyless path.
    CMPIObjectPath* locatePhysicalPackage(const CMPIObjectPath* objectPath);
    CMPIObjectPath* locateComputerSystem(const CMPIObjectPath* objectPath);
    CMPIObjectPath* locatePartner(const CMPIObjectPath* objectPath) { return locatePhysicalPackage(objectPath); }
    CMPIObjectPath* locateComputer(const CMPIObjectPath* objectPath) { return locateComputerSystem(objectPath); }

    /// Whether the result class is not that of the other end from the request's, nor its DMTF base class. Letter case
    /// does not matter. True for a request from neither end.
    bool isNotTargetClass(const char* resultClass) const;

    /// Adds "PlatformGUID", where the host has one.
    void addProperties(CMPIInstance* instance);

    static constexpr char className[] = "VESKA_ComputerSystemPackage";
    static constexpr char adapterName[] = "CMPIComputerSystemPackage";
    static constexpr char destructorName[] = "~CMPIComputerSystemPackage";
    static constexpr ClassId associationClassId = ClassId::ComputerSystemPackage;
    static constexpr ClassId partnerClassId = ClassId::PhysicalPackage;
    static constexpr char computerRole[] = "Dependent";
    static constexpr char partnerRole[] = "Antecedent";
    static constexpr const char* roles[] = {partnerRole, computerRole};
    static const TraceSource& traceSource();
};

} // namespace VK::BaseServerProvider
