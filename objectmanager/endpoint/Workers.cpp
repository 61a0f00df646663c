#include "objectmanager/endpoint/Workers.h"

#include <system_error>
#include <thread>

namespace endpoint {

Workers::Workers(std::size_t threads, std::size_t longestQueue, std::size_t mostThreads)
    : longest(longestQueue), most(mostThreads) {
    for (std::size_t i = 0; i < threads; ++i) start();
}

Workers::~Workers() {
    using namespace std::chrono_literals;
    stop(0s, 1s);
}

void Workers::start() {
    {
        const std::lock_guard lock(shared->mutex);
        ++shared->threads;
    }
    try {
        std::thread([own = shared] { work(own); }).detach();
    } catch (...) {
        const std::lock_guard lock(shared->mutex);
        --shared->threads;
        throw;
    }
}

/// Under the lock. Nobody, where all are at work.
std::shared_ptr<Workers::Sleeper> Workers::called(Shared& shared) {
    if (shared.asleep.empty()) return nullptr;
    std::shared_ptr<Sleeper> sleeper = std::move(shared.asleep.back());
    shared.asleep.pop_back();
    sleeper->called = true;
    return sleeper;
}

void Workers::work(const std::shared_ptr<Shared>& shared) {
    const auto own = std::make_shared<Sleeper>();
    std::unique_lock lock(shared->mutex);
    for (;;) {
        while (!shared->stopping && shared->surplus == 0 && shared->queue.empty()) {
            own->called = false;
            shared->asleep.push_back(own);
            own->changed.wait(lock, [&] { return own->called; });
        }
        if (shared->stopping || shared->surplus > 0) break;
        const std::function<void()> job = std::move(shared->queue.front());
        shared->queue.pop_front();
        lock.unlock();
        job();
        lock.lock();
    }
    if (shared->surplus > 0) --shared->surplus;
    --shared->threads;
    shared->ended.notify_all();
}

bool Workers::post(std::function<void()> job) {
    std::shared_ptr<Sleeper> sleeper;
    {
        const std::lock_guard lock(shared->mutex);
        if (shared->stopping || shared->queue.size() >= longest) return false;
        shared->queue.push_back(std::move(job));
        sleeper = called(*shared);
    }
    if (sleeper) sleeper->changed.notify_one(); // who is woken need not wait for the lock
    return true;
}

bool Workers::replace() {
    {
        const std::lock_guard lock(shared->mutex);
        ++shared->hanging;
        if (shared->threads >= most) return false;
    }
    try {
        start();
    } catch (const std::system_error&) { // no thread is to be had: the others serve on
        return false;
    }
    return true;
}

void Workers::cameBack(bool replaced) {
    const std::lock_guard lock(shared->mutex);
    --shared->hanging;
    if (!replaced) return;
    ++shared->surplus;
    if (const auto sleeper = called(*shared)) sleeper->changed.notify_one();
}

bool Workers::stop(std::chrono::milliseconds patience, std::chrono::milliseconds patienceWithHanging) {
    std::unique_lock lock(shared->mutex);
    shared->stopping = true;
    shared->queue.clear();
    while (const auto sleeper = called(*shared)) sleeper->changed.notify_one();
    shared->ended.wait_for(lock, patience, [&] { return shared->threads <= shared->hanging; });
    return shared->ended.wait_for(lock, patienceWithHanging, [&] { return shared->threads == 0; });
}

} // namespace endpoint
