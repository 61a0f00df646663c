#pragma once

#include "fuzz/Choices.h"

#include <string>

namespace fuzz {

/// A simulated host of up to seven nodes.
struct RandomHost {
    std::string json; ///< its file
    /// Whether every computer has a name and every chassis a serial number, no two the same: only then does every
    /// path of an association name one.
    bool namesAreUnique = true;
};

/// The names and serial numbers that hosts and requests have in common.
inline constexpr std::array<const char*, 5> nodeNames = {"node7", "node8", "CZ1", "CZ2", ""};

/// `hostName` is this host's, which the time service carries.
RandomHost randomHost(Choices& choices, const std::string& hostName);

} // namespace fuzz
