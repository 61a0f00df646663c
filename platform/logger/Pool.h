#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>

namespace NVLog {

/// Objects that wait to be used, for all threads, without locks: one takes any that nobody uses and gives it back, or
/// finds none and makes its own. Taking costs one atomic exchange, giving back a store. The objects go with the pool,
/// but for those in use then, which stay for good: threads may log while the process ends. Before the pool is made
/// there is nothing to take: other objects' constructors may log.
///
/// An Object knows where it goes back to: its `std::atomic<bool>* free`, null for one that came from elsewhere.
template <typename Object>
class Pool {
public:
    Object* take() noexcept {
        const std::size_t first = firstPlace();
        for (std::size_t i = 0; i < places.size(); ++i) {
            Place& place = places[(first + i) % places.size()];
            if (place.free.load(std::memory_order_relaxed) && place.free.exchange(false, std::memory_order_acquire))
                return &place.object;
        }
        return nullptr;
    }

    /// Deletes an object that did not come from a pool.
    static void give(Object* object) noexcept {
        if (object->free != nullptr)
            object->free->store(true, std::memory_order_release);
        else
            delete object;
    }

private:
    /// On cache lines of its own, so that threads do not slow each other down.
    struct alignas(64) Place {
        Place() : object() {
            object.free = &free;
            free.store(true, std::memory_order_release);
        }
        ~Place() {
            if (free.exchange(false)) object.~Object();
        }
        Place(const Place&) = delete;
        Place& operator=(const Place&) = delete;

        std::atomic<bool> free{false};
        union {
            Object object;
        };
    };

    /// Threads start at different places, which follow from their stacks' addresses.
    static std::size_t firstPlace() noexcept {
        const auto stack = reinterpret_cast<std::uintptr_t>(__builtin_frame_address(0));
        return stack / (64 * 1024);
    }

    std::array<Place, 32> places{};
};

} // namespace NVLog
