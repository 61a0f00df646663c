#include "include/Lasting.h"

#include <atomic>

namespace VK {

/// All of them, as a chain without a lock, so that the child of a fork finds none that is held.
class LastingObjects {
public:
    void add(Lasting* object) noexcept {
        object->next = newest.load(std::memory_order_relaxed);
        while (!newest.compare_exchange_weak(object->next, object, std::memory_order_release)) {
        }
    }

    void free() noexcept {
        Lasting* object = newest.exchange(nullptr, std::memory_order_acquire);
        while (object != nullptr) {
            Lasting* const next = object->next;
            delete object;
            object = next;
        }
    }

private:
    std::atomic<Lasting*> newest{nullptr};
};

namespace {

constinit LastingObjects lastingObjects;
constinit std::atomic<bool> processEnds{false};

/// exit() destroys the static objects of libraries that were loaded while the process ran first, and runs the
/// libraries' own end afterwards. Where a library is unloaded, its end comes first and destroys its static objects; and
/// so it does at exit where the program was linked with the library, as no object manager is with a provider.
struct EndOfProcess {
    ~EndOfProcess() { processEnds = true; }
};
[[maybe_unused]] const EndOfProcess endOfProcess;

__attribute__((destructor)) void endOfLibrary() {
    if (!processEnds) lastingObjects.free();
}

struct LastingText : Lasting {
    explicit LastingText(const char* theText) : text(theText) {}
    std::string text;
};

} // namespace

void Lasting::keep(Lasting* object) noexcept {
    lastingObjects.add(object);
}

std::string& lastingString(const char* text) {
    auto* const made = new LastingText(text);
    Lasting::keep(made);
    return made->text;
}

} // namespace VK
