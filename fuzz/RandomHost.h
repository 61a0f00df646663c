#pragma once

#include "fuzz/Choices.h"

#include <optional>
#include <string>
#include <vector>

namespace fuzz {

/// What identifies each node of a type, in order; nothing for a node that has no such text.
using Identities = std::vector<std::optional<std::string>>;

/// A simulated host of up to seven nodes.
struct RandomHost {
    std::string json;     ///< its file
    Identities computers; ///< their names
    Identities chassis;   ///< their serial numbers
};

/// The names and serial numbers that hosts and requests have in common.
inline constexpr std::array<const char*, 5> nodeNames = {"node7", "node8", "CZ1", "CZ2", ""};

/// `hostName` is this host's, which the time service carries.
RandomHost randomHost(Choices& choices, const std::string& hostName);

} // namespace fuzz
