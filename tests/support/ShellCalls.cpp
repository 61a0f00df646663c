#include "support/ShellCalls.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <dlfcn.h>
#include <mutex>
#include <optional>
#include <utility>

namespace {

struct Calls {
    std::mutex mutex;
    std::vector<std::string> made;
    std::string refused;
    std::string replaced;
    std::string replacement;
};

Calls& calls() {
    static Calls one;
    return one;
}

/// Keeps a call: the command to start for it, or nothing where it cannot be started.
std::optional<std::string> keep(const std::string& how, std::string command) {
    const std::lock_guard lock(calls().mutex);
    calls().made.push_back(how + ": " + command);
    const auto contains = [&](const std::string& text) {
        return !text.empty() && command.find(text) != std::string::npos;
    };
    if (contains(calls().refused)) {
        errno = EMFILE;
        return std::nullopt;
    }
    const std::string& replaced = calls().replaced;
    if (contains(replaced)) command.replace(command.find(replaced), replaced.size(), calls().replacement);
    return command;
}

/// The C library's own function, which ours stands before.
template <class Function>
Function* original(const char* name) {
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

} // namespace

extern "C" FILE* popen(const char* command, const char* mode) {
    static const auto real = original<FILE*(const char*, const char*)>("popen");
    const auto started = keep("popen " + std::string(mode), command);
    return started ? real(started->c_str(), mode) : nullptr;
}

extern "C" int system(const char* command) {
    static const auto real = original<int(const char*)>("system");
    const auto started = keep("system", command);
    return started ? real(started->c_str()) : -1;
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

void startInstead(const std::string& text, const std::string& replacement) {
    const std::lock_guard lock(calls().mutex);
    calls().replaced = text;
    calls().replacement = replacement;
}

} // namespace test
