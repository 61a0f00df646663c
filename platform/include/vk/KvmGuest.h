#pragma once

extern "C" {

/// Whether the host below the directory, `/` for this one, is a KVM guest as VK::hostIsKVM() (vk/HostFacts.h) finds
/// out: 1 or 0. For programs in other languages: libvkcommon has it under this very name.
int vkIsKvmGuest(const char* root);

} // extern "C"
