#pragma once

#include <nlohmann/json.hpp>

#include <string>
#include <vector>

namespace test {

struct CommandResult {
    int exitStatus = -1; ///< 128 and the signal for a killed command
    std::string output;
};

/// Runs a shell command and waits for it; standard error goes where this process's goes.
CommandResult run(const std::string& command);

/// `text` as one word of a shell command.
std::string quoted(const std::string& text);

/// The answer of `vkcim --format json ARGUMENTS`, with `environment` (shell assignments) set.
nlohmann::json vkcim(const std::vector<std::string>& arguments, const std::string& environment = "");

} // namespace test
