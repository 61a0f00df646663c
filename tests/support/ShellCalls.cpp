#include "support/ShellCalls.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <dlfcn.h>
#include <mutex>
#include <utility>

namespace {

struct Calls {
    std::mutex mutex;
    std::vector<std::string> made;
    std::string refused;
};

Calls& calls() {
    static Calls one;
    return one;
}

/// Keeps a call; whether the command may be started.
bool keep(const std::string& how, const std::string& command) {
    const std::lock_guard lock(calls().mutex);
    calls().made.push_back(how + ": " + command);
    const std::string& refused = calls().refused;
    if (refused.empty() || command.find(refused) == std::string::npos) return true;
    errno = EMFILE;
    return false;
}

/// The C library's own function, which ours stands before.
template <class Function>
Function* original(const char* name) {
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

} // namespace

extern "C" FILE* popen(const char* command, const char* mode) {
    static const auto real = original<FILE*(const char*, const char*)>("popen");
    return keep("popen " + std::string(mode), command) ? real(command, mode) : nullptr;
}

extern "C" int system(const char* command) {
    static const auto real = original<int(const char*)>("system");
    return keep("system", command) ? real(command) : -1;
}

namespace test {

std::vector<std::string> takeShellCalls() {
    const std::lock_guard lock(calls().mutex);
    return std::exchange(calls().made, {});
}

void refuseToStart(const std::string& text) {
    const std::lock_guard lock(calls().mutex);
    calls().refused = text;
}

} // namespace test
