#include "support/Command.h"

#include <array>
#include <cstdio>
#include <stdexcept>

#include <sys/wait.h>

namespace test {

CommandResult run(const std::string& command) {
    std::FILE* const stream = popen(command.c_str(), "re");
    if (stream == nullptr) throw std::runtime_error("cannot run " + command);
    CommandResult result;
    std::array<char, 4096> block{};
    while (const std::size_t length = std::fread(block.data(), 1, block.size(), stream))
        result.output.append(block.data(), length);
    const int status = pclose(stream);
    result.exitStatus = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
    return result;
}

std::string quoted(const std::string& text) {
    std::string word = "'";
    for (const char character : text) word += character == '\'' ? std::string("'\\''") : std::string(1, character);
    return word + "'";
}

nlohmann::json vkcim(const std::vector<std::string>& arguments, const std::string& environment) {
    std::string command = environment + " " + quoted(VKCIM_PROGRAM) + " --format json";
    for (const std::string& argument : arguments) command += " " + quoted(argument);
    const CommandResult result = run(command);
    if (result.output.empty())
        throw std::runtime_error(command + " printed nothing, exit " + std::to_string(result.exitStatus));
    return nlohmann::json::parse(result.output);
}

} // namespace test
