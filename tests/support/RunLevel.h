#pragma once

#include <cstring>
#include <string>
#include <utmp.h>

namespace support {

/// A record of /run/utmp that says the run level.
inline std::string runLevel(char now, char before = 'N') {
    utmp entry{};
    entry.ut_type = RUN_LVL;
    entry.ut_pid = now + 256 * before;
    std::string bytes(sizeof entry, '\0');
    std::memcpy(bytes.data(), &entry, sizeof entry);
    return bytes;
}

} // namespace support
