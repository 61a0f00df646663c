#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>

#pragma GCC visibility push(hidden)

namespace NVLog {

/// Objects that nobody uses just now, for all threads, without locks: one takes any of them, or finds none and
/// makes its own; what finds no place when put back is the caller's to delete.
template <typename Object>
class Pool {
public:
    Pool() = default;
    ~Pool() {
        for (auto& place : places) delete place.exchange(nullptr);
    }
    Pool(const Pool&) = delete;
    Pool& operator=(const Pool&) = delete;

    Object* take() noexcept {
        const std::size_t first = firstPlace();
        for (std::size_t i = 0; i < places.size(); ++i) {
            auto& place = places[(first + i) % places.size()];
            if (place.load(std::memory_order_relaxed) == nullptr) continue;
            if (Object* const found = place.exchange(nullptr, std::memory_order_acquire)) return found;
        }
        return nullptr;
    }

    bool put(Object* object) noexcept {
        const std::size_t first = firstPlace();
        for (std::size_t i = 0; i < places.size(); ++i) {
            Object* none = nullptr;
            auto& place = places[(first + i) % places.size()];
            if (place.compare_exchange_strong(none, object, std::memory_order_release, std::memory_order_relaxed))
                return true;
        }
        return false;
    }

private:
    /// Threads start at different places, told apart by where their stacks lie.
    static std::size_t firstPlace() noexcept {
        const auto stack = reinterpret_cast<std::uintptr_t>(__builtin_frame_address(0));
        return stack / (64 * 1024);
    }

    std::array<std::atomic<Object*>, 32> places{};
};

} // namespace NVLog

#pragma GCC visibility pop
