#pragma once

#include <cstddef>
#include <functional>

namespace support {

/// How often operator new was called while something ran. Counting takes support/Allocations.cpp in the test program.
std::size_t allocationsDuring(const std::function<void()>& run);

} // namespace support
