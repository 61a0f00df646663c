#pragma once

#include <string>

namespace VK {

/// Facts about the installed product and the machine it is built for. Read once per process. Nothing is thrown but
/// std::bad_alloc.
class Product {
public:
    /// The processor architecture as the kernel names it (uname), `x86_64` for example.
    static std::wstring getArchitecture();
    /// The installation root, `<prefix>/lib/vk/platform/`, always with a final slash.
    static std::wstring getRootDirectory();
    /// An identifier in the form of a UUID that is stable on one host and differs between hosts: derived from
    /// /etc/machine-id, else from the system UUID, never showing either. Empty where neither is known.
    static std::wstring getUid();
};

} // namespace VK
