#include "vk/Kept.h"

#include <atomic>
#include <cerrno>

namespace VK {

namespace {

std::atomic<unsigned int> shortages{0};

} // namespace

void noteShortage(int error) {
    if (error == EMFILE || error == ENFILE || error == ENOMEM) ++shortages;
}

ShortageWatch::ShortageWatch() : before(shortages) {}

bool ShortageWatch::seen() const {
    return shortages != before;
}

} // namespace VK
