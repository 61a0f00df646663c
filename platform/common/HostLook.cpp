#include "vk/HostLook.h"

#include "vk/HostSource.h"

#include <atomic>

namespace VK {

namespace {

thread_local std::uint64_t current = 0; // without a destructor: the library can be unloaded

} // namespace

HostLook::HostLook() {
    static std::atomic<std::uint64_t> last{0};
    if (HostSource::current().kind == HostSource::Live || current != 0) return;
    outermost = true;
    current = ++last;
}

HostLook::~HostLook() {
    if (outermost) current = 0;
}

std::uint64_t HostLook::number() {
    return current;
}

} // namespace VK
