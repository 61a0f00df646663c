#include "support/Allocations.h"

#include <atomic>
#include <cstdlib>
#include <new>

namespace {

std::atomic<std::size_t> allocations{0};
std::atomic<bool> isShort{false};
std::atomic<void (*)()> next{nullptr};

} // namespace

// In place of the standard library's, in this program and the libraries that it loads.
void* operator new(std::size_t size) {
    ++allocations;
    if (void (*const call)() = next.exchange(nullptr); call != nullptr) call();
    if (isShort) throw std::bad_alloc();
    if (void* const memory = std::malloc(size != 0 ? size : 1)) return memory;
    throw std::bad_alloc();
}

void operator delete(void* memory) noexcept {
    std::free(memory);
}
void operator delete(void* memory, std::size_t) noexcept {
    std::free(memory);
}

std::size_t support::allocationsDuring(const std::function<void()>& run) {
    const std::size_t before = allocations;
    run();
    return allocations - before;
}

void support::atNextAllocation(void (*call)()) {
    next = call;
}

support::MemoryShortage::MemoryShortage() {
    isShort = true;
}
support::MemoryShortage::~MemoryShortage() {
    isShort = false;
}
