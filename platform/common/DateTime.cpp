#include "vk/DateTime.h"

#include "common/CivilTime.h"

#include <array>
#include <cstdio>

namespace VK {

DateTime::DateTime(long secondsSinceEpoch, unsigned int) : seconds(secondsSinceEpoch) {}

DateTime::operator std::string() const {
    const CivilTime time = civilTime(seconds);
    if (time.year < 0 || time.year > 9999) return {};
    std::array<char, 32> text{};
    std::snprintf(text.data(), text.size(), "%04ld%02d%02d%02d%02d%02d.000000+000", time.year, time.month, time.day,
                  time.hour, time.minute, time.second);
    return text.data();
}

} // namespace VK
