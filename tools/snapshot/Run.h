#pragma once

#include "tools/CommandLine.h"

#include <string>
#include <vector>

namespace snapshot {

/// The program vk-host-snapshot with the words behind its name; returns its exit status.
int run(const std::vector<std::string>& words, tools::Output output);

} // namespace snapshot
