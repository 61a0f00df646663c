#pragma once

#include <string>

namespace VK {

/// Facts about the installed product and the machine it is built for. Read once per process. A simulated host's file
/// may say otherwise of each (vk/HostSource.h). Nothing is thrown but std::bad_alloc.
class Product {
public:
    /// The processor architecture as the kernel names it (uname), `x86_64` for example. Of a snapshot what its
    /// /proc/sys/kernel/arch says, where there is one.
    static std::wstring getArchitecture();
    /// The installation root, `<prefix>/lib/vk/platform/`, always with a final slash.
    static std::wstring getRootDirectory();
    /// An identifier in the form of a UUID (version 8) that is stable on one host and differs between hosts: a keyed
    /// hash of /etc/machine-id, else of the system UUID, never showing either. Empty where neither is known.
    static std::wstring getUid();
};

} // namespace VK
