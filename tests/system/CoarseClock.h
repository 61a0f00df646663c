#pragma once

#include <atomic>

namespace test {

// A program that links this, and exports its symbols, has the process's clocks: clock_gettime is found before the C
// library's. What a host that runs shows is as old as its coarse clock says; the others are asked by system calls.

/// What the coarse clock says.
extern std::atomic<long> coarseMilliseconds;
/// What passes on it with every look; none at first.
extern std::atomic<long> coarseStep;

} // namespace test
