#pragma once

#include "tools/CommandLine.h"

#include <string>
#include <vector>

namespace check {

/// The program vk-provider-check with the words behind its name; returns its exit status.
int run(const std::vector<std::string>& words, tools::Output output);

} // namespace check
