#include "load/Requests.h"
#include "load/Resources.h"
#include "load/Runs.h"

#include <condition_variable>
#include <cstdio>
#include <functional>
#include <mutex>
#include <stdexcept>
#include <thread>

namespace load {
namespace {

/// A thread that lives on from one task to the next, as an object manager's do.
class Worker {
public:
    Worker() : thread([this] { loop(); }) {}
    ~Worker() {
        run({});
        thread.join();
    }
    Worker(const Worker&) = delete;
    Worker& operator=(const Worker&) = delete;

    /// Runs a task and waits for it; an empty one ends the thread.
    void run(std::function<void()> newTask) {
        std::unique_lock<std::mutex> lock(mutex);
        task = std::move(newTask);
        pending = true;
        changed.notify_all();
        changed.wait(lock, [this] { return !pending; });
    }

private:
    void loop() {
        for (bool last = false; !last;) {
            std::unique_lock<std::mutex> lock(mutex);
            changed.wait(lock, [this] { return pending; });
            last = !task;
            if (task) task();
            task = nullptr;
            pending = false;
            changed.notify_all();
        }
    }

    std::mutex mutex;
    std::condition_variable changed;
    std::function<void()> task;
    bool pending = false;
    std::thread thread;
};

constexpr unsigned warmRounds = 3;
constexpr std::size_t heapTolerance = 1024;
constexpr std::size_t residentTolerance = 1024 * 1024;

/// Asks what runs no commands; the name of a kind that answered differently, empty when none did.
std::string wrongAmong(om::ObjectManager& manager, const std::vector<Kind>& kinds) {
    for (const Kind& kind : kinds)
        if (!kind.slow && ask(manager, kind.request) != kind.answer) return kind.name;
    return "";
}

/// One life of the provider; `kinds` are found out in the first one and stay true in the others.
void round(const std::string& library, Worker& worker, std::vector<Kind>& kinds) {
    om::ObjectManager manager(library, "BaseServerProvider", "root/cimv2");
    if (kinds.empty()) kinds = allKinds(manager);
    std::string wrong = wrongAmong(manager, kinds);
    if (wrong.empty()) worker.run([&] { wrong = wrongAmong(manager, kinds); });
    if (!wrong.empty()) throw std::runtime_error(wrong + " answered differently");
    if (mappedLibraries().size() != 6) throw std::runtime_error("not all six libraries were in use");
}

void checkUnloaded(unsigned number) {
    const std::vector<std::string> left = mappedLibraries();
    if (left.empty()) return;
    std::string names;
    for (const std::string& name : left) names += " " + name;
    throw std::runtime_error("still mapped after round " + std::to_string(number) + ":" + names);
}

} // namespace

void runUnload(const std::string& library, unsigned times) {
    Worker worker;
    std::vector<Kind> kinds;
    Resources start;
    for (unsigned number = 1; number <= times; ++number) {
        round(library, worker, kinds);
        checkUnloaded(number);
        if (number == warmRounds) start = Resources::now();
    }
    const Resources end = Resources::now();
    std::printf("unload: %u times, all libraries gone every time; descriptors %zu, then %zu", times, start.descriptors,
                end.descriptors);
    if (memoryTells())
        std::printf("; heap %zu, then %zu; resident %zu, then %zu bytes", start.heap, end.heap, start.resident,
                    end.resident);
    std::printf("\n");
    if (times <= warmRounds) return;
    if (end.descriptors > start.descriptors) throw std::runtime_error("descriptors are left open");
    if (end.heap > start.heap + heapTolerance) throw std::runtime_error("memory is not freed");
    if (end.resident > start.resident + residentTolerance) throw std::runtime_error("resident memory grows");
}

} // namespace load
