#include "support/FakeCommands.h"

#include <cstdlib>
#include <fstream>

namespace test {
namespace {

namespace fs = std::filesystem;

/// What stands behind the prefix; the whole text where it does not begin with it.
std::string behind(const std::string& prefix, const std::string& text) {
    return text.compare(0, prefix.size(), prefix) == 0 ? text.substr(prefix.size()) : text;
}

} // namespace

FakeCommands::FakeCommands() {
    if (const char* path = std::getenv("PATH")) formerPath = path;
    fs::create_directories(bin());
    setenv("PATH", (bin().string() + ":/usr/bin:/bin").c_str(), 1);
}

FakeCommands::~FakeCommands() {
    setenv("PATH", formerPath.c_str(), 1);
}

void FakeCommands::add(const fs::path& command, const std::string& script) {
    const fs::path file = bin() / command;
    fs::create_directories(file.parent_path());
    const fs::path temporary = file.string() + ".new";
    // The call is written at once, so that the lines of commands that run side by side stay whole.
    std::ofstream(temporary) << "#!/bin/sh\n"
                             << "call=$0\n"
                             << "for argument; do call=\"$call [$argument]\"; done\n"
                             << "printf '%s\\n' \"$call\" >>'" << path("calls").string() << "'\n"
                             << script << "\n";
    fs::permissions(temporary, fs::perms::owner_all | fs::perms::group_exec | fs::perms::others_exec);
    fs::rename(temporary, file);
}

std::vector<std::string> FakeCommands::take() {
    std::ifstream file(path("calls"));
    std::vector<std::string> calls;
    for (std::string line; std::getline(file, line);)
        calls.push_back(behind(path("").string(), behind(bin().string() + "/", line)));
    std::error_code ignored;
    fs::remove(path("calls"), ignored);
    return calls;
}

std::string notingOverlaps(const std::string& directory) {
    const std::string busy = "'" + directory + "/busy'";
    return "mkdir " + busy + " || echo overlap >>'" + directory + "/overlaps'\nsleep 0.03\nrmdir " + busy;
}

std::string printing(const std::vector<std::string>& lines) {
    std::string script;
    for (const std::string& line : lines) script += "printf '%s\\n' '" + line + "'\n";
    return script;
}

} // namespace test
