#pragma once

#include <CLI/CLI.hpp>

#include <optional>
#include <ostream>
#include <string>
#include <vector>

namespace tools {

/// Where a program writes.
struct Output {
    std::ostream& out;
    std::ostream& error;
};

constexpr int unusableArguments = 2;

/// The options that every program has.
void addCommonOptions(CLI::App& app);

/// Reads the words behind the program's name: nothing, or the exit status where an answer was printed already.
std::optional<int> parse(CLI::App& app, const std::vector<std::string>& words, Output output);

/// Why what was named cannot be looked into as a directory; nothing where it can.
std::optional<std::string> problemOfDirectory(const std::string& path);

/// Says why arguments cannot be used, and returns the exit status.
int refuse(const CLI::App& app, const std::string& problem, Output output);

} // namespace tools
