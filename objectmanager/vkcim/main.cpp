#include "objectmanager/vkcim/Arguments.h"
#include "objectmanager/vkcim/OwnOutput.h"
#include "objectmanager/vkcim/Run.h"
#include "objectmanager/vkcim/Terminal.h"

#include <iostream>
#include <string>
#include <vector>

int main(int argc, char** argv) {
    const vkcim::Parsed parsed = vkcim::parseArguments(std::vector<std::string>(argv + (argc > 0), argv + argc));
    const vkcim::Look look = vkcim::lookOfStandardOutput();
    vkcim::OwnOutput output;
    if (parsed.arguments)
        return vkcim::run(*parsed.arguments, {std::cin, output, std::cerr, look, vkcim::widthOfMessages()});
    output << vkcim::wrapped(parsed.output, look.width) << std::flush;
    std::cerr << vkcim::wrapped(parsed.error, vkcim::widthOfMessages());
    if (output) return parsed.exitStatus;
    std::cerr << "vkcim: the help cannot be written\n";
    return 1;
}
