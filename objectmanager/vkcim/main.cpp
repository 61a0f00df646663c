#include "objectmanager/vkcim/Arguments.h"
#include "objectmanager/vkcim/Run.h"

#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <iostream>
#include <string>
#include <vector>

namespace {

/// Colours are for terminals, and for nobody who said no (https://no-color.org).
bool wantsColours() {
    const char* refused = std::getenv("NO_COLOR");
    const char* terminal = std::getenv("TERM");
    return isatty(STDOUT_FILENO) == 1 && !(refused && *refused) && terminal && std::strcmp(terminal, "dumb") != 0;
}

} // namespace

int main(int argc, char** argv) {
    const vkcim::Parsed parsed = vkcim::parseArguments(std::vector<std::string>(argv + (argc > 0), argv + argc));
    if (parsed.arguments) return vkcim::run(*parsed.arguments, {std::cin, std::cout, std::cerr, wantsColours()});
    std::cout << parsed.output << std::flush;
    std::cerr << parsed.error;
    return parsed.exitStatus;
}
