#pragma once

#include <atomic>
#include <memory>
#include <utility>

namespace VK {

/// Whether an errno value says that descriptors or memory ran out.
bool isShortage(int error);

/// Notes why something could not be opened, where descriptors or memory ran out.
void noteShortage(int error);

/// Whether something could not be opened since it was made because descriptors or memory ran out, in any thread: then
/// what was read meanwhile may be less than the host has, and is not to be kept.
class ShortageWatch {
public:
    ShortageWatch();
    bool seen() const;

private:
    const unsigned int before;
};

/// Something that is read once and kept for good, unless descriptors ran out while it was read: then it is read again
/// the next time. Takes no lock, which the fork of a process could find taken for ever: threads that come first at once
/// all read, and what one of them read is kept.
template <class T>
class Kept {
public:
    Kept() = default;
    ~Kept() { delete place.load(); }
    Kept(const Kept&) = delete;
    Kept& operator=(const Kept&) = delete;

    /// Never null. `announce` is called with what is kept, once.
    template <class Read, class Announce>
    std::shared_ptr<const T> get(Read read, Announce announce) {
        if (const Pointer* const found = place.load(std::memory_order_acquire); found != nullptr) return *found;
        const ShortageWatch shortage;
        auto fresh = std::make_unique<const Pointer>(std::make_shared<const T>(read()));
        if (shortage.seen()) return *fresh;
        const Pointer* found = nullptr;
        if (!place.compare_exchange_strong(found, fresh.get())) return *found;
        found = fresh.release();
        announce(**found);
        return *found;
    }

    template <class Read>
    std::shared_ptr<const T> get(Read read) {
        return get(std::move(read), [](const T&) {});
    }

private:
    using Pointer = std::shared_ptr<const T>;

    std::atomic<const Pointer*> place{nullptr};
};

} // namespace VK
