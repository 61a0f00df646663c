#pragma once

#include <cstddef>
#include <filesystem>
#include <iterator>

namespace support {

/// How many file descriptors this process has open, and one more: the one with which they are counted.
inline std::size_t openDescriptors() {
    using Directory = std::filesystem::directory_iterator;
    return static_cast<std::size_t>(std::distance(Directory("/proc/self/fd"), Directory()));
}

} // namespace support
