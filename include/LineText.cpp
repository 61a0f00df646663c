#include "include/LineText.h"

#include "include/Lasting.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace VK {
namespace {

/// One string, on cache lines of its own, so that threads do not slow each other down. No lock is waited for: in the
/// child of a fork, what other threads had taken stays taken.
struct alignas(64) SharedText {
    std::atomic<bool> taken{false};
    std::string* text = nullptr; ///< belongs to who took it
};

constinit std::array<SharedText, 32> sharedTexts;

/// Threads start at different places, which follow from their stacks' addresses.
std::size_t firstPlace() {
    const auto stack = reinterpret_cast<std::uintptr_t>(__builtin_frame_address(0));
    return stack / (64 * std::size_t{1024});
}

SharedText* takeSharedText() {
    const std::size_t first = firstPlace();
    for (std::size_t i = 0; i < sharedTexts.size(); ++i) {
        SharedText& shared = sharedTexts[(first + i) % sharedTexts.size()];
        if (!shared.taken.load(std::memory_order_relaxed) && !shared.taken.exchange(true, std::memory_order_acquire))
            return &shared;
    }
    return nullptr;
}

} // namespace

LineText::LineText() {
    SharedText* const shared = takeSharedText();
    if (shared == nullptr) return;
    taken.flag = &shared->taken;
    if (shared->text == nullptr) {
        shared->text = &lastingString("");
        shared->text->reserve(MessageBuffer::size);
    }
    text = shared->text;
}

} // namespace VK
