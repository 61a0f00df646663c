#pragma once

#include <string>
#include <vector>

namespace support {

/// The lines logged since the last call, as `LEVEL TEXT`. This program's own logger takes the place of the library.
std::vector<std::string> takeLog();

} // namespace support
