#include "common/HostLook.h"

#include "vk/HostSource.h"
#include "vk/WithinLook.h"

namespace VK {

namespace {

thread_local HostLook* current = nullptr; // without a destructor: the library can be unloaded

} // namespace

HostLook::HostLook() {
    if (HostSource::current().kind == HostSource::Live || current != nullptr) return;
    outermost = true;
    current = this;
}

HostLook::~HostLook() {
    if (outermost) current = nullptr;
}

std::shared_ptr<const void>* HostLook::kept(const void* source) {
    if (current == nullptr) return nullptr;
    for (Place& place : current->places) {
        if (place.source == nullptr) place.source = source;
        if (place.source == source) return &place.value;
    }
    return nullptr;
}

} // namespace VK

void vkWithinLook(void (*work)(void*), void* data) {
    const VK::HostLook look;
    work(data);
}
