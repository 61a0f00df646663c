#pragma once

#include <cstdlib>

namespace support {

inline constexpr char noRealMachines[] = "VK_TEST_HOSTS does not name a directory with snapshots of real machines";

/// The directory with snapshots of real machines that VK_TEST_HOSTS names; null where it names none.
inline const char* realMachines() {
    const char* const directory = std::getenv("VK_TEST_HOSTS");
    return directory == nullptr || *directory == '\0' ? nullptr : directory;
}

} // namespace support
