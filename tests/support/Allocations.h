#pragma once

#include <cstddef>
#include <functional>

namespace support {

/// How often operator new was called while something ran. Counting takes support/Allocations.cpp in the test program.
std::size_t allocationsDuring(const std::function<void()>& run);

/// Calls this within the next call of operator new, as another thread might.
void atNextAllocation(void (*call)());

/// While it lives, operator new throws.
class MemoryShortage {
public:
    MemoryShortage();
    ~MemoryShortage();
    MemoryShortage(const MemoryShortage&) = delete;
    MemoryShortage& operator=(const MemoryShortage&) = delete;
};

} // namespace support
