#pragma once

#include "common/HostLook.h"
#include "common/SeenFiles.h"
#include "vk/Kept.h"

#include <atomic>
#include <memory>
#include <sched.h>

namespace VK {

/// A lock that is held for a few instructions, and so is free again at once. A process that was forked while another
/// thread held it never gets it, and goes on without it.
class BriefLock {
public:
    explicit BriefLock(std::atomic_flag& theFlag) : flag(theFlag) {
        constexpr int patience = 1000;
        for (int i = 0; i < patience && !held; ++i) {
            held = !flag.test_and_set(std::memory_order_acquire);
            if (!held) sched_yield();
        }
    }
    ~BriefLock() {
        if (held) flag.clear(std::memory_order_release);
    }
    BriefLock(const BriefLock&) = delete;
    BriefLock& operator=(const BriefLock&) = delete;

    explicit operator bool() const { return held; }

private:
    std::atomic_flag& flag;
    bool held = false;
};

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
        std::shared_ptr<const void>* const ofLook = HostLook::kept(this);
        if (ofLook != nullptr && *ofLook) return std::static_pointer_cast<const T>(*ofLook);
        std::shared_ptr<const T> value = asked(root, read);
        if (ofLook != nullptr) *ofLook = value;
        return value;
    }

    /// To be called after a change of our own.
    void forget() {
        if (std::shared_ptr<const void>* const ofLook = HostLook::kept(this); ofLook != nullptr) ofLook->reset();
    }

private:
    struct Made {
        explicit Made(const Root& root) : files(root) {}
        SeenFiles files;
        T value{};
    };
    using Pointer = std::shared_ptr<const Made>;

    static std::shared_ptr<const T> valueOf(const Pointer& made) { return {made, &made->value}; }

    template <class Read>
    std::shared_ptr<const T> asked(const Root& root, Read read) {
        const Pointer known = take();
        if (known && known->files.unchanged()) return valueOf(known);
        const ShortageWatch shortage;
        const auto fresh = std::make_shared<Made>(root);
        fresh->value = read(fresh->files);
        if (shortage.seen()) return valueOf(known ? known : fresh);
        keep(fresh);
        return valueOf(fresh);
    }

    Pointer take() {
        const BriefLock lock(busy);
        return lock ? made : nullptr;
    }

    void keep(Pointer fresh) {
        if (const BriefLock lock(busy); lock) made.swap(fresh); // what was there before goes without the lock
    }

    std::atomic_flag busy = ATOMIC_FLAG_INIT;
    Pointer made;
};

} // namespace VK
