#pragma once

#include <csignal>
#include <cstdlib>
#include <functional>
#include <optional>
#include <string>
#include <sys/ptrace.h>
#include <sys/wait.h>
#include <unistd.h>

namespace support {

/// What became of a run that was to be killed.
enum Outcome { Killed, Finished, NotTraced };

/// Lets a process that is being traced go on to its next stop at the begin or end of a system call; false when it came
/// to its end instead.
inline bool goOn(pid_t child) {
    int status = 0;
    ptrace(PTRACE_SYSCALL, child, nullptr, nullptr);
    waitpid(child, &status, 0);
    return !WIFEXITED(status);
}

/// Runs something in a process that is killed as it begins its n-th system call.
inline Outcome runKilledAt(const std::function<void()>& run, int n) {
    const pid_t child = fork();
    if (child == 0) {
        if (ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0) _exit(99);
        raise(SIGSTOP);
        run();
        _exit(0);
    }
    int status = 0;
    waitpid(child, &status, 0);
    if (WIFEXITED(status)) return NotTraced;
    for (int call = 0; call < n; ++call)
        if (!goOn(child) || !goOn(child)) return Finished;
    if (!goOn(child)) return Finished;
    kill(child, SIGKILL);
    waitpid(child, &status, 0);
    return Killed;
}

/// A directory in memory, where there is a place for it: hundreds of synchronised files take long on a disk.
template <class Directory>
class InMemory {
public:
    InMemory() {
        const char* const found = getenv("TMPDIR");
        const std::optional<std::string> before = found != nullptr ? std::optional<std::string>(found) : std::nullopt;
        if (access("/dev/shm", W_OK) == 0) setenv("TMPDIR", "/dev/shm", 1);
        directory.emplace();
        if (before)
            setenv("TMPDIR", before->c_str(), 1);
        else
            unsetenv("TMPDIR");
    }
    const Directory& operator*() const { return *directory; }

private:
    std::optional<Directory> directory;
};

} // namespace support
