#pragma once

#include <string>

namespace VK::BaseServerProvider {

/// The kernel's host name as it stood when the object was made. Empty when gethostname failed; at most 128 bytes, also
/// when the kernel left no terminator.
class HostName {
public:
    HostName();
    std::string text() const;

private:
    char field[128] = {};
};

} // namespace VK::BaseServerProvider
