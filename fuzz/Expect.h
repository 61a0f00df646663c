#pragma once

#include <cstdio>
#include <cstdlib>

namespace fuzz {

/// Ends the program with what does not hold, which the fuzzer keeps the input for.
inline void expect(bool holds, const char* what) {
    if (holds) return;
    std::fprintf(stderr, "%s\n", what);
    std::abort();
}

} // namespace fuzz
