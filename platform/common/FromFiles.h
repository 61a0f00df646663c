#pragma once

#include "common/HostLook.h"
#include "common/Published.h"
#include "common/SeenFiles.h"
#include "vk/Kept.h"

#include <memory>

namespace VK {

/// What is made of a root's files, made anew only when one of them has changed. Any number of threads may use it.
template <class T>
class FromFiles {
public:
    FromFiles() = default;
    FromFiles(const FromFiles&) = delete;
    FromFiles& operator=(const FromFiles&) = delete;

    /// As the files are now, or were when the thread's look (HostLook.h) asked first. `read` makes it, and adds every
    /// file to the list that it is given before it reads it. What was made before stays where descriptors run out.
    template <class Read>
    std::shared_ptr<const T> get(const Root& root, Read read) {
        return HostLook::once<T>(this, [&] { return asked(root, read); });
    }

    /// To be called after a change of our own.
    void forget() { HostLook::forget(this); }

private:
    struct Made {
        explicit Made(const Root& root) : files(root) {}
        SeenFiles files;
        T value{};
    };
    using Pointer = typename Published<Made>::Pointer;

    static std::shared_ptr<const T> valueOf(const Pointer& made) { return {made, &made->value}; }

    template <class Read>
    std::shared_ptr<const T> asked(const Root& root, Read read) {
        const Pointer known = made.get();
        if (known && known->files.unchanged()) return valueOf(known);
        const ShortageWatch shortage;
        const auto fresh = std::make_shared<Made>(root);
        fresh->value = read(fresh->files);
        if (shortage.seen()) return valueOf(known ? known : fresh);
        made.exchange(fresh);
        return valueOf(fresh);
    }

    Published<Made> made;
};

} // namespace VK
