#pragma once

namespace VK::BaseServerProvider {

/// Calls `work` with `data` while the thread takes one look at the host, where libvkcommon can do that
/// (vk/WithinLook.h); a library that stands in for it need not.
void withinLook(void (*work)(void*), void* data);

template <class Work>
void withinLook(Work work) {
    withinLook([](void* given) { (*static_cast<Work*>(given))(); }, &work);
}

} // namespace VK::BaseServerProvider
