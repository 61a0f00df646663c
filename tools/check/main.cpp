#include "tools/check/Run.h"

#include <iostream>

int main(int argc, char** argv) {
    const int status = check::run({argv + 1, argv + argc}, {std::cout, std::cerr});
    return std::cout.flush() ? status : 1;
}
