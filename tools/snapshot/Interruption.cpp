#include "tools/snapshot/Interruption.h"

#include <csignal>
#include <initializer_list>

namespace snapshot {

namespace {

volatile std::sig_atomic_t interrupted = 0;

} // namespace

void catchInterruptions() {
    interrupted = 0;
    for (const int number : {SIGHUP, SIGINT, SIGTERM}) {
        struct sigaction action {};
        if (sigaction(number, nullptr, &action) == 0 && action.sa_handler == SIG_IGN) continue;
        action = {};
        action.sa_handler = [](int) { interrupted = 1; };
        action.sa_flags = static_cast<int>(SA_RESETHAND);
        sigaction(number, &action, nullptr);
    }
}

void throwIfInterrupted() {
    if (interrupted != 0) throw Interrupted();
}

} // namespace snapshot
