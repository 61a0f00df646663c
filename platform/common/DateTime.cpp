#include "vk/DateTime.h"

#include "common/CimDateTime.h"

namespace VK {

DateTime::DateTime(long secondsSinceEpoch, unsigned int) : seconds(secondsSinceEpoch) {}

DateTime::operator std::string() const {
    constexpr long earliest = -62167219200; // 0000-01-01 00:00:00
    constexpr long latest = 253402300799;   // 9999-12-31 23:59:59
    if (seconds < earliest || seconds > latest) return {};
    return formatCimDateTime({seconds, 0}, 0);
}

} // namespace VK
