#include "vk/Kept.h"

#include <atomic>
#include <cerrno>

namespace VK {

namespace {

std::atomic<unsigned int> shortages{0};

} // namespace

bool isShortage(int error) {
    return error == EMFILE || error == ENFILE || error == ENOMEM;
}

void noteShortage(int error) {
    if (isShortage(error)) ++shortages;
}

ShortageWatch::ShortageWatch() : before(shortages) {}

bool ShortageWatch::seen() const {
    return shortages != before;
}

} // namespace VK
