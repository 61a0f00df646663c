#include "provider/Look.h"

#include "vk/WithinLook.h"

#include <atomic>
#include <dlfcn.h>

namespace VK::BaseServerProvider {
namespace {

using Look = decltype(&vkWithinLook);

void searchLook(void (*work)(void*), void* data);

constinit std::atomic<Look> look{searchLook}; ///< from the first call on, what was found

void withoutLook(void (*work)(void*), void* data) {
    work(data);
}

/// Among the libraries that the provider was loaded with. Nobody waits for another thread's search.
void searchLook(void (*work)(void*), void* data) {
    const auto found = reinterpret_cast<Look>(dlsym(RTLD_DEFAULT, "vkWithinLook"));
    look = found != nullptr ? found : withoutLook;
    withinLook(work, data);
}

} // namespace

void withinLook(void (*work)(void*), void* data) {
    look.load(std::memory_order_relaxed)(work, data);
}

} // namespace VK::BaseServerProvider
