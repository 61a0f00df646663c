#include "objectmanager/vkcim/HostNotes.h"

#include "objectmanager/vkcim/Arguments.h"

#include "vk/HostNotes.h"

#include <dlfcn.h>

#include <memory>

namespace vkcim {

// The library is neither linked nor loaded from here: only the one that the provider brought is asked (RTLD_NOLOAD),
// so that the notes are on the same host, and vkcim runs where that library is another one or is missing.
std::vector<std::string> hostNotes(const std::string& provider) {
    if (provider != Arguments().provider) return {};
    const std::unique_ptr<void, int (*)(void*)> library(dlopen("libvkinstrumentation.so.1", RTLD_NOW | RTLD_NOLOAD),
                                                        &dlclose);
    if (!library) return {};
    const auto ask = reinterpret_cast<decltype(&vkHostNotes)>(dlsym(library.get(), "vkHostNotes"));
    std::vector<std::string> notes;
    if (ask != nullptr)
        ask([](void* list, const char* note) { static_cast<std::vector<std::string>*>(list)->emplace_back(note); },
            &notes);
    return notes;
}

} // namespace vkcim
