#include "providerutilities/ClassTable.h"

#include "vk/ProviderUtilities.h"

#include <strings.h>

namespace VK {

namespace {

struct Row {
    unsigned short id;
    const char* name;
};

constexpr Row CLASSES[] = {
    {1, "VESKA_ComputerSystem"},
    {22, "VESKA_PhysicalPackage"},
    {23, "VESKA_EnabledLogicalElementCapabilities"},
    {24, "VESKA_ComputerSystemPackage"},
    {33, "VESKA_ComputerCapabilities"},
    {161, "VESKA_TimeService"},
    {162, "VESKA_TimeServiceAffectsElement"},
    {185, "VESKA_CIMServiceConfig"},
};

} // namespace

unsigned short findClassId(const char* className) {
    if (className == nullptr) return ProviderUtilities::CLASS_ID_UNKNOWN;
    for (const Row& row : CLASSES) {
        if (strcasecmp(row.name, className) == 0) return row.id;
    }
    return ProviderUtilities::CLASS_ID_UNKNOWN;
}

} // namespace VK
