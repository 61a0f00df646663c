/* The coarse clock stands still, so that nothing of a host that runs grows a second old. */
#define _GNU_SOURCE
#include <sys/syscall.h>
#include <time.h>
#include <unistd.h>

int clock_gettime(clockid_t clock, struct timespec* time) {
    if (clock != CLOCK_MONOTONIC_COARSE) return (int)syscall(SYS_clock_gettime, clock, time);
    time->tv_sec = 100;
    time->tv_nsec = 0;
    return 0;
}
