#pragma once

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

/// What one thread made for all. A process that was forked while another thread was at it keeps nothing in it.
template <class T>
class Published {
public:
    using Pointer = std::shared_ptr<const T>;

    /// What was put in last; null before.
    Pointer get() {
        const BriefLock lock(busy);
        return lock ? value : nullptr;
    }

    /// Puts another in, and returns what was there before, which goes without the lock.
    Pointer exchange(Pointer fresh) {
        if (const BriefLock lock(busy); lock) value.swap(fresh);
        return fresh;
    }

private:
    std::atomic_flag busy = ATOMIC_FLAG_INIT;
    Pointer value;
};

} // namespace VK
