#include "objectmanager/vkcim/Arguments.h"
#include "objectmanager/vkcim/OwnOutput.h"
#include "objectmanager/vkcim/Run.h"

#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <iostream>
#include <string>
#include <vector>

namespace {

/// Colours only on a terminal, and only unless the user refused them (https://no-color.org).
bool wantsColours() {
    const char* refused = std::getenv("NO_COLOR");
    const char* terminal = std::getenv("TERM");
    return isatty(STDOUT_FILENO) == 1 && !(refused && *refused) && terminal && std::strcmp(terminal, "dumb") != 0;
}

} // namespace

int main(int argc, char** argv) {
    const vkcim::Parsed parsed = vkcim::parseArguments(std::vector<std::string>(argv + (argc > 0), argv + argc));
    const bool colours = wantsColours();
    vkcim::OwnOutput output;
    if (parsed.arguments) return vkcim::run(*parsed.arguments, {std::cin, output, std::cerr, colours});
    output << parsed.output << std::flush;
    std::cerr << parsed.error;
    if (output) return parsed.exitStatus;
    std::cerr << "vkcim: the help cannot be written\n";
    return 1;
}
