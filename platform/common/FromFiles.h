#pragma once

#include "common/SeenFiles.h"
#include "vk/HostLook.h"
#include "vk/Kept.h"

#include <atomic>
#include <cstdint>
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

    /// As the files are now, or were when the thread's look began (vk/HostLook.h). `read` makes it, and adds every file
    /// to the list that it is given before it reads it. What was made before stays where descriptors run out.
    template <class Read>
    std::shared_ptr<const T> get(const Root& root, Read read) {
        const std::uint64_t look = HostLook::number();
        bool current = false;
        Pointer known = take(look, current);
        if (current) return valueOf(known);
        if (known && known->files.unchanged()) return keep(std::move(known), look);
        const ShortageWatch shortage;
        const auto fresh = std::make_shared<Made>(root);
        fresh->value = read(fresh->files);
        if (shortage.seen()) return valueOf(known ? known : fresh);
        return keep(fresh, look);
    }

    /// To be called after a change of our own.
    void forget() {
        if (const BriefLock lock(busy); lock) lookAt = 0;
    }

private:
    struct Made {
        explicit Made(const Root& root) : files(root) {}
        SeenFiles files;
        T value{};
    };
    using Pointer = std::shared_ptr<const Made>;

    static std::shared_ptr<const T> valueOf(const Pointer& made) { return {made, &made->value}; }

    Pointer take(std::uint64_t look, bool& current) {
        const BriefLock lock(busy);
        current = lock && made && look != 0 && look == lookAt;
        return lock ? made : nullptr;
    }

    std::shared_ptr<const T> keep(Pointer known, std::uint64_t look) {
        std::shared_ptr<const T> value = valueOf(known);
        if (const BriefLock lock(busy); lock) {
            made.swap(known); // what was there before goes without the lock
            lookAt = look;
        }
        return value;
    }

    std::atomic_flag busy = ATOMIC_FLAG_INIT;
    Pointer made;
    std::uint64_t lookAt = 0; ///< in which the files were asked last
};

} // namespace VK
