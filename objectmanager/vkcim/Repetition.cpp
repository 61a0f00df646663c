#include "objectmanager/vkcim/Repetition.h"

#include <fmt/format.h>

#include <algorithm>
#include <atomic>
#include <condition_variable>
#include <exception>
#include <mutex>
#include <thread>

namespace vkcim {
namespace {

using Clock = std::chrono::steady_clock;

/// Lets no thread go on before all have arrived.
class StartLine {
public:
    explicit StartLine(std::size_t count) : missing(count) {}

    void wait() {
        std::unique_lock lock(mutex);
        if (--missing == 0) everybody.notify_all();
        everybody.wait(lock, [this] { return missing == 0; });
    }
    /// For a thread that will never arrive.
    void giveUp(std::size_t count) {
        const std::lock_guard lock(mutex);
        missing -= count;
        if (missing == 0) everybody.notify_all();
    }

private:
    std::mutex mutex;
    std::condition_variable everybody;
    std::size_t missing;
};

struct Lane {
    om::Answer last;
    CMPIrc failed = CMPI_RC_OK;
    std::optional<std::string> failedMessage;
    std::vector<Nanoseconds> times;
    Clock::time_point start, end;
    std::exception_ptr error;
};

void runLane(Lane& lane, const RunOnce& once, std::size_t repeat, bool keepTimes, std::atomic<bool>& stop) {
    try {
        if (keepTimes) lane.times.reserve(repeat);
        lane.start = Clock::now();
        for (std::size_t i = 0; i < repeat && !stop; ++i) {
            Nanoseconds elapsed{0};
            lane.last = once(elapsed);
            if (lane.failed == CMPI_RC_OK) {
                lane.failed = lane.last.code;
                lane.failedMessage = lane.last.message;
            }
            if (keepTimes) lane.times.push_back(elapsed);
        }
        lane.end = Clock::now();
    } catch (...) {
        lane.error = std::current_exception();
        stop = true;
    }
}

void runLanes(std::vector<Lane>& lanes, const RunOnce& once, std::size_t repeat, bool keepTimes) {
    std::atomic<bool> stop{false};
    if (lanes.size() == 1) return runLane(lanes.front(), once, repeat, keepTimes, stop);
    StartLine line(lanes.size());
    std::vector<std::thread> threads;
    threads.reserve(lanes.size());
    const auto joinAll = [&threads] {
        for (std::thread& thread : threads) thread.join();
    };
    try {
        for (Lane& lane : lanes) {
            threads.emplace_back([&] {
                line.wait();
                runLane(lane, once, repeat, keepTimes, stop);
            });
        }
    } catch (...) { // no more threads to be had
        stop = true;
        line.giveUp(lanes.size() - threads.size());
        joinAll();
        throw;
    }
    joinAll();
}

Nanoseconds percentile(const std::vector<Nanoseconds>& sorted, std::size_t percent) {
    const std::size_t rank = (sorted.size() * percent + 99) / 100;
    return sorted[rank - 1];
}

} // namespace

Repeated repeatedly(const RunOnce& once, std::size_t repeat, std::size_t threads, bool keepTimes) {
    std::vector<Lane> lanes(threads);
    runLanes(lanes, once, repeat, keepTimes);
    Repeated result;
    Clock::time_point start = lanes.front().start;
    Clock::time_point end = lanes.front().end;
    for (Lane& lane : lanes) {
        if (lane.error) std::rethrow_exception(lane.error);
        start = std::min(start, lane.start);
        end = std::max(end, lane.end);
        if (result.worst == 0 && lane.failed != CMPI_RC_OK) {
            result.worst = static_cast<int>(lane.failed);
            result.worstMessage = lane.failedMessage;
        }
        result.timing.runs.insert(result.timing.runs.end(), lane.times.begin(), lane.times.end());
    }
    result.answer = std::move(lanes.front().last);
    result.timing.wall = end - start;
    return result;
}

std::string timingText(const Timing& timing) {
    std::vector<Nanoseconds> sorted = timing.runs;
    if (sorted.empty()) return {};
    std::sort(sorted.begin(), sorted.end());
    return fmt::format(R"({{"runs":{},"min_ns":{},"median_ns":{},"p99_ns":{},"max_ns":{},"wall_ns":{}}})",
                       sorted.size(), sorted.front().count(), percentile(sorted, 50).count(),
                       percentile(sorted, 99).count(), sorted.back().count(), timing.wall.count());
}

} // namespace vkcim
