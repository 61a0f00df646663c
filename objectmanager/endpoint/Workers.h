#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <memory>
#include <mutex>
#include <vector>

namespace endpoint {

/// Threads that run jobs in their order. A job that hangs holds its thread for good; `replace` lets another thread take
/// its place, so that the others never wait for it.
class Workers {
public:
    Workers(std::size_t threads, std::size_t longestQueue, std::size_t mostThreads);
    /// Lets the jobs that are running end if they can within a second; those that hang are left to the process's end.
    ~Workers();
    Workers(const Workers&) = delete;
    Workers& operator=(const Workers&) = delete;

    /// Whether the job was taken; the queue is full otherwise.
    bool post(std::function<void()> job);
    /// Says that a job hangs, and starts a thread beside its own; false where there are too many already, or where none
    /// can be started.
    bool replace();
    /// Says that such a job came back. Where its thread had been replaced, one thread is too many then.
    void cameBack(bool replaced);

    /// Drops what waits, and gives running jobs that time to end: those that hang, the second one. Whether all threads
    /// have ended.
    bool stop(std::chrono::milliseconds patience, std::chrono::milliseconds patienceWithHanging);

private:
    /// A thread that waits for a job.
    struct Sleeper {
        std::condition_variable changed;
        bool called = false;
    };

    /// Outlives the object while a thread hangs.
    struct Shared {
        std::mutex mutex;
        std::vector<std::shared_ptr<Sleeper>> asleep; ///< whoever fell asleep last is called first: its memory is warm
        std::condition_variable ended;                ///< a thread
        std::deque<std::function<void()>> queue;
        std::size_t threads = 0;
        std::size_t hanging = 0; ///< of them
        std::size_t surplus = 0; ///< threads that are to end
        bool stopping = false;
    };

    static void work(const std::shared_ptr<Shared>& shared);
    static std::shared_ptr<Sleeper> called(Shared& shared);
    void start();

    std::shared_ptr<Shared> shared = std::make_shared<Shared>();
    std::size_t longest;
    std::size_t most;
};

} // namespace endpoint
