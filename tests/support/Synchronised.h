#pragma once

#include <string>
#include <vector>

namespace support {

/// What has been synchronised with the disk, by path, in order. This program's own fsync takes the place of the
/// library's, and calls it.
std::vector<std::string>& synchronised();

} // namespace support
