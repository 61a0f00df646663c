#include "provider/Look.h"

#include "vk/WithinLook.h"

#include <atomic>
#include <dlfcn.h>

namespace VK::BaseServerProvider {

void withinLook(void (*work)(void*), void* data) {
    // Among the libraries that the provider was loaded with. Found once; nobody waits for another thread's search.
    static std::atomic<decltype(&vkWithinLook)> found{nullptr};
    static std::atomic<bool> searched{false};
    if (!searched.load(std::memory_order_acquire)) {
        found = reinterpret_cast<decltype(&vkWithinLook)>(dlsym(RTLD_DEFAULT, "vkWithinLook"));
        searched.store(true, std::memory_order_release);
    }
    const auto look = found.load(std::memory_order_relaxed);
    if (look == nullptr) return work(data);
    look(work, data);
}

} // namespace VK::BaseServerProvider
