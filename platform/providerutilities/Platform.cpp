#include "vk/ProviderUtilities.h"

#include "vk/HostFacts.h"

namespace VK {

bool ProviderUtilities::isKVM() {
    return hostIsKVM();
}

} // namespace VK
