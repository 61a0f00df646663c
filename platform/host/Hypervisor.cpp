#include "host/Hypervisor.h"

#include "vk/KvmGuest.h"

int vkIsKvmGuest(const char* root) {
    const VK::Root host(root);
    return VK::Host::isKvmGuest(host, VK::Host::readHardware(host)) ? 1 : 0;
}

bool VK::Host::isKvmGuest(const Root& root, const HardwareFacts& facts) {
    return (root.isLive() && processorSaysKvm()) || facts.firmwareModel.text.starts_with("KVM") ||
           facts.firmwareManufacturer.text.starts_with("QEMU");
}

#if defined(__x86_64__) || defined(__i386__)

#include <cpuid.h>
#include <cstring>

namespace VK::Host {

bool processorSaysKvm() {
    constexpr unsigned int underHypervisor = 1U << 31;
    constexpr unsigned int hypervisorLeaf = 0x40000000;
    unsigned int a = 0, b = 0, c = 0, d = 0;
    // Processors without a hypervisor also return something for that leaf.
    if (__get_cpuid(1, &a, &b, &c, &d) == 0 || (c & underHypervisor) == 0) return false;
    char signature[12];
    __cpuid(hypervisorLeaf, a, b, c, d);
    std::memcpy(signature, &b, 4);
    std::memcpy(signature + 4, &c, 4);
    std::memcpy(signature + 8, &d, 4);
    return std::memcmp(signature, "KVMKVMKVM\0\0\0", sizeof signature) == 0;
}

} // namespace VK::Host

#else

bool VK::Host::processorSaysKvm() {
    return false;
}

#endif
