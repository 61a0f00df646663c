#include "providerutilities/ClassTable.h"

#include "vk/ProviderUtilities.h"

#include <strings.h>

namespace VK {

namespace {

struct Row {
    ClassId id;
    const char* name;
};

constexpr Row classes[] = {
    {ClassId::ComputerSystem, "VESKA_ComputerSystem"},
    {ClassId::PhysicalPackage, "VESKA_PhysicalPackage"},
    {ClassId::EnabledLogicalElementCapabilities, "VESKA_EnabledLogicalElementCapabilities"},
    {ClassId::ComputerSystemPackage, "VESKA_ComputerSystemPackage"},
    {ClassId::ComputerCapabilities, "VESKA_ComputerCapabilities"},
    {ClassId::TimeService, "VESKA_TimeService"},
    {ClassId::TimeServiceAffectsElement, "VESKA_TimeServiceAffectsElement"},
    {ClassId::CIMServiceConfig, "VESKA_CIMServiceConfig"},
};

} // namespace

unsigned short findClassId(const char* className) {
    if (className == nullptr) return ProviderUtilities::CLASS_ID_UNKNOWN;
    for (const Row& row : classes) {
        if (strcasecmp(row.name, className) == 0) return static_cast<unsigned short>(row.id);
    }
    return ProviderUtilities::CLASS_ID_UNKNOWN;
}

} // namespace VK
