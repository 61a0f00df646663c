#include "common/FileLock.h"

#include <cerrno>
#include <chrono>
#include <fcntl.h>
#include <sys/file.h>
#include <thread>

namespace VK {

namespace {

constexpr std::chrono::seconds LONGEST_WAIT{10};
constexpr std::chrono::milliseconds BETWEEN_TRIES{5};

int waitForLock(int fd) {
    const auto end = std::chrono::steady_clock::now() + LONGEST_WAIT;
    while (flock(fd, LOCK_EX | LOCK_NB) != 0) {
        if (errno != EWOULDBLOCK && errno != EINTR) return errno;
        if (std::chrono::steady_clock::now() >= end) return EWOULDBLOCK;
        std::this_thread::sleep_for(BETWEEN_TRIES);
    }
    return 0;
}

} // namespace

FileLock::FileLock(int folder, const std::string& name)
    : file(openat(folder, name.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600)) {
    failure = file ? waitForLock(file.get()) : errno;
}

} // namespace VK
