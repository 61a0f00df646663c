#include "load/Requests.h"
#include "load/Runs.h"

#include <atomic>
#include <chrono>
#include <cstdio>
#include <mutex>
#include <stdexcept>
#include <thread>

namespace load {
namespace {

/// What the threads share.
struct Shared {
    Shared(om::ObjectManager& theManager, const std::vector<Kind>& theKinds) : manager(theManager), kinds(theKinds) {}

    om::ObjectManager& manager;
    const std::vector<Kind>& kinds;
    std::atomic<bool> stop{false};
    std::atomic<std::size_t> asked{0};
    std::mutex mutex;
    std::string failure; ///< the first one; under the mutex

    void fail(const std::string& text) {
        const std::lock_guard<std::mutex> lock(mutex);
        if (failure.empty()) failure = text;
        stop = true;
    }
};

void work(Shared& shared, unsigned seed) {
    Picker picker(shared.kinds, seed);
    while (!shared.stop) {
        const Kind& kind = picker.next();
        const std::string answer = ask(shared.manager, kind.request);
        ++shared.asked;
        if (answer != kind.answer) shared.fail(kind.name + "\n  answered " + answer + "\n  but alone " + kind.answer);
    }
}

} // namespace

void runThreads(const std::string& library, unsigned threads, unsigned seconds) {
    om::ObjectManager manager(library, "BaseServerProvider", "root/cimv2");
    const std::vector<Kind> kinds = allKinds(manager);
    Shared shared(manager, kinds);
    std::vector<std::thread> running;
    for (unsigned index = 0; index < threads; ++index)
        running.emplace_back([&shared, index] { work(shared, index + 1); });
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(seconds);
    while (!shared.stop && std::chrono::steady_clock::now() < end)
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    shared.stop = true;
    for (std::thread& thread : running) thread.join();
    if (!shared.failure.empty()) throw std::runtime_error(shared.failure);
    if (shared.asked < threads) throw std::runtime_error("some threads never got to ask");
    std::printf("threads: %u threads, %u s, %zu requests of %zu kinds, all answered as in a single thread\n", threads,
                seconds, shared.asked.load(), kinds.size());
}

} // namespace load
