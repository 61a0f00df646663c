#pragma once

#include "objectmanager/model/Values.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <string>
#include <vector>

namespace vkcim {

using Nanoseconds = std::chrono::nanoseconds;

/// How long the runs took.
struct Timing {
    std::vector<Nanoseconds> runs;
    Nanoseconds wall{0}; ///< from the first run's start to the last one's end
};

struct Repeated {
    om::Answer answer; ///< of the first thread's last run
    int worst = 0;     ///< the status of the first run that was not OK, in the order of threads; 0 when all were
    std::optional<std::string> worstMessage;
    Timing timing; ///< its runs are empty unless they were asked for
};

/// One run: what was answered, and the time spent in the provider.
using RunOnce = std::function<om::Answer(Nanoseconds& elapsed)>;

/// Runs `once` `repeat` times in each of `threads` threads, which start together. An exception ends the thread it
/// came up in and the others after their current run, and is passed on.
Repeated repeatedly(const RunOnce& once, std::size_t repeat, std::size_t threads, bool keepTimes);

/// The line of `--timing`: percentiles by nearest rank.
std::string timingText(const Timing& timing);

} // namespace vkcim
