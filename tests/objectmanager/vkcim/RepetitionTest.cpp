#include "objectmanager/vkcim/Repetition.h"

#include <gtest/gtest.h>

#include <atomic>
#include <numeric>
#include <thread>

namespace vkcim {
namespace {

om::Answer answerNumbered(int number, CMPIrc code = CMPI_RC_OK) {
    om::Answer answer;
    answer.code = code;
    answer.returnValue = om::Value{CMPI_sint64, std::int64_t{number}};
    return answer;
}

TEST(Repetition, RunsEachThreadSoOften) {
    std::atomic<int> calls{0};
    const Repeated result = repeatedly(
        [&](Nanoseconds& elapsed) {
            elapsed = Nanoseconds(++calls);
            return om::Answer();
        },
        7, 3, true);
    EXPECT_EQ(calls, 21);
    EXPECT_EQ(result.timing.runs.size(), 21u);
    EXPECT_EQ(std::accumulate(result.timing.runs.begin(), result.timing.runs.end(), Nanoseconds(0)), Nanoseconds(231));
    EXPECT_GT(result.timing.wall.count(), 0);
}

TEST(Repetition, TheAnswerIsThatOfTheLastRun) {
    int calls = 0;
    const Repeated result = repeatedly([&](Nanoseconds&) { return answerNumbered(++calls); }, 5, 1, false);
    EXPECT_EQ(std::get<std::int64_t>(result.answer.returnValue->data), 5);
    EXPECT_TRUE(result.timing.runs.empty());
}

TEST(Repetition, OneFailureAmongManyIsKept) {
    int calls = 0;
    const Repeated result = repeatedly(
        [&](Nanoseconds&) {
            ++calls;
            return answerNumbered(calls, calls == 2 ? CMPI_RC_ERR_FAILED : CMPI_RC_OK);
        },
        5, 1, false);
    EXPECT_EQ(result.worst, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(result.answer.code, CMPI_RC_OK);
}

TEST(Repetition, AllThreadsAreInsideAtOnce) {
    constexpr int threads = 4;
    std::atomic<int> inside{0};
    const Repeated result = repeatedly(
        [&](Nanoseconds&) {
            ++inside;
            const auto giveUp = std::chrono::steady_clock::now() + std::chrono::seconds(20);
            while (inside < threads && std::chrono::steady_clock::now() < giveUp) std::this_thread::yield();
            return answerNumbered(inside);
        },
        1, threads, false);
    EXPECT_EQ(std::get<std::int64_t>(result.answer.returnValue->data), threads);
}

TEST(Repetition, AnExceptionStopsEverybodyAndIsPassedOn) {
    std::atomic<int> calls{0};
    const auto once = [&](Nanoseconds&) -> om::Answer {
        ++calls;
        throw std::runtime_error("no library");
    };
    EXPECT_THROW(repeatedly(once, 1000000, 4, false), std::runtime_error);
    EXPECT_LE(calls, 4);
}

Timing timesOneTo(int count) {
    Timing timing;
    for (int i = count; i > 0; --i) timing.runs.emplace_back(i);
    timing.wall = Nanoseconds(1234);
    return timing;
}

TEST(Repetition, PercentilesAreOfTheNearestRank) {
    EXPECT_EQ(timingText(timesOneTo(1)), R"({"runs":1,"min_ns":1,"median_ns":1,"p99_ns":1,"max_ns":1,"wall_ns":1234})");
    EXPECT_EQ(timingText(timesOneTo(4)), R"({"runs":4,"min_ns":1,"median_ns":2,"p99_ns":4,"max_ns":4,"wall_ns":1234})");
    EXPECT_EQ(timingText(timesOneTo(200)),
              R"({"runs":200,"min_ns":1,"median_ns":100,"p99_ns":198,"max_ns":200,"wall_ns":1234})");
}

} // namespace
} // namespace vkcim
