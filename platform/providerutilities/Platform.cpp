#include "vk/ProviderUtilities.h"

#if __has_include("vk/HostFacts.h")
#include "vk/HostFacts.h"
#endif

namespace VK {

bool ProviderUtilities::isKVM() {
#if __has_include("vk/HostFacts.h")
    static const bool kvm = hostIsKVM();
    return kvm;
#else
    return false;
#endif
}

} // namespace VK
