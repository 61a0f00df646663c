#include "objectmanager/vkcim/HostNotes.h"

#include "objectmanager/vkcim/Arguments.h"

#include "nvlog/LogWatch.h"
#include "vk/HostNotes.h"

#include <dlfcn.h>
#include <sys/utsname.h>

#include <mutex>

namespace vkcim {
namespace {

using Library = std::unique_ptr<void, int (*)(void*)>;

// The libraries are neither linked nor loaded from here: only those that the provider brought are asked (RTLD_NOLOAD),
// so that the answers are on the same host, and vkcim runs where a library is another one or is missing.
Library loaded(const char* name) {
    return {dlopen(name, RTLD_NOW | RTLD_NOLOAD), &dlclose};
}

template <class Function>
Function lookUp(const Library& library, const char* name) {
    return library ? reinterpret_cast<Function>(dlsym(library.get(), name)) : nullptr;
}

/// What a function of vk/HostNotes.h hands over.
std::vector<std::string> asked(const std::string& provider, const char* file, const char* name) {
    if (provider != Arguments().provider) return {};
    const Library library = loaded(file);
    std::vector<std::string> notes;
    if (const auto ask = lookUp<decltype(&vkHostNotes)>(library, name))
        ask([](void* list, const char* note) { static_cast<std::vector<std::string>*>(list)->emplace_back(note); },
            &notes);
    return notes;
}

constexpr const char* common = "libvkcommon.so.1";

std::string first(const std::vector<std::string>& notes) {
    return notes.empty() ? std::string() : notes.front();
}

} // namespace

std::vector<std::string> hostNotes(const std::string& provider) {
    return asked(provider, "libvkinstrumentation.so.1", "vkHostNotes");
}

std::string hostProblem(const std::string& provider) {
    return first(asked(provider, common, "vkHostProblem"));
}

HostClock hostClock(const std::string& provider) {
    const auto known = [&](const char* name) {
        const std::string text = first(asked(provider, common, name));
        return text.empty() ? std::nullopt : std::optional(text);
    };
    return {known("vkHostTime"), known("vkHostOffset")};
}

std::string hostDescribed(const std::string& provider) {
    const std::string other = first(asked(provider, common, "vkHostSource"));
    return other.empty() ? "this host, " + kernelsHostName() : other;
}

std::string kernelsHostName() {
    utsname names{};
    return uname(&names) == 0 ? names.nodename : "";
}

class LastFailure::Watch {
public:
    Watch() : library(loaded("libnvlog.so.1")), set(lookUp<decltype(&nvLogWatch)>(library, "nvLogWatch")) {
        if (set != nullptr) set(&ours);
    }
    ~Watch() {
        if (set != nullptr) set(nullptr);
    }
    Watch(const Watch&) = delete;
    Watch& operator=(const Watch&) = delete;

    std::string text() const {
        const std::lock_guard<std::mutex> lock(mutex);
        return last;
    }

private:
    static void take(void* watch, int level, const char* text) {
        constexpr int failure = 6000;
        auto& self = *static_cast<Watch*>(watch);
        const std::lock_guard<std::mutex> lock(self.mutex);
        if (level == failure) self.last = text;
    }

    mutable std::mutex mutex;
    std::string last;
    const NVLogWatch ours{&take, this};
    const Library library;
    decltype(&nvLogWatch) const set;
};

LastFailure::LastFailure() : watch(std::make_unique<Watch>()) {}

LastFailure::~LastFailure() = default;

std::string LastFailure::text() const {
    return watch->text();
}

} // namespace vkcim
