#include "objectmanager/endpoint/Workers.h"

#include <gtest/gtest.h>

#include <pthread.h>

#include <future>

namespace endpoint {
namespace {

using namespace std::chrono_literals;

/// A job that runs until it is let go.
struct Job {
    std::promise<void> started;
    std::promise<void> released;

    void post(Workers& workers) {
        EXPECT_TRUE(workers.post([this] {
            started.set_value();
            released.get_future().wait();
        }));
        started.get_future().wait();
    }
};

TEST(Workers, AStopDoesNotWaitForAJobThatHangs) {
    Job job;
    Workers workers(1, 1, 2);
    job.post(workers);
    EXPECT_TRUE(workers.replace());
    EXPECT_FALSE(workers.stop(std::chrono::hours(1), 0ms));
    job.released.set_value();
    EXPECT_TRUE(workers.stop(0ms, std::chrono::hours(1)));
}

TEST(Workers, AStopWaitsForAJobThatCameBack) {
    Job job;
    Job next;
    Workers workers(1, 1, 1);
    job.post(workers);
    EXPECT_FALSE(workers.replace()); // there is one already
    job.released.set_value();
    next.post(workers);
    workers.cameBack(false);
    std::future<bool> stopped =
        std::async(std::launch::async, [&] { return workers.stop(std::chrono::hours(1), 0ms); });
    while (workers.post([] {})) std::this_thread::yield();
    next.released.set_value();
    EXPECT_TRUE(stopped.get());
}

/// Threads that nobody can start: no address space is left for their stacks.
class NoThreads {
public:
    NoThreads() {
        pthread_getattr_default_np(&usual);
        pthread_attr_t huge;
        pthread_attr_init(&huge);
        pthread_attr_setstacksize(&huge, std::size_t{1} << 60U);
        EXPECT_EQ(pthread_setattr_default_np(&huge), 0);
        pthread_attr_destroy(&huge);
    }
    ~NoThreads() { pthread_setattr_default_np(&usual); }
    NoThreads(const NoThreads&) = delete;
    NoThreads& operator=(const NoThreads&) = delete;

private:
    pthread_attr_t usual{};
};

TEST(Workers, ServeOnWhereNoThreadCanBeStarted) {
    Job job;
    Workers workers(1, 1, 2);
    job.post(workers);
    {
        const NoThreads none;
        EXPECT_FALSE(workers.replace());
    }
    job.released.set_value();
    Job next;
    next.post(workers);
    next.released.set_value();
    EXPECT_TRUE(workers.stop(std::chrono::hours(1), std::chrono::hours(1)));
}

} // namespace
} // namespace endpoint
