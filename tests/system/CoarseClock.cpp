#include "system/CoarseClock.h"

#include <ctime>
#include <sys/syscall.h>
#include <unistd.h>

namespace test {

std::atomic<long> coarseMilliseconds{100'000};
std::atomic<long> coarseStep{0};

} // namespace test

extern "C" __attribute__((visibility("default"))) int clock_gettime(clockid_t clock, timespec* time) noexcept {
    if (clock != CLOCK_MONOTONIC_COARSE) return static_cast<int>(syscall(SYS_clock_gettime, clock, time));
    const long now = test::coarseMilliseconds += test::coarseStep;
    *time = {now / 1000, now % 1000 * 1'000'000};
    return 0;
}
