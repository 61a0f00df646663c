#include "common/FileLock.h"

#include <cerrno>
#include <chrono>
#include <fcntl.h>
#include <sys/file.h>
#include <thread>

namespace VK {

namespace {

constexpr std::chrono::seconds longestWait{10};
constexpr std::chrono::milliseconds betweenTries{5};

int waitForLock(int fd) {
    const auto end = std::chrono::steady_clock::now() + longestWait;
    while (flock(fd, LOCK_EX | LOCK_NB) != 0) {
        if (errno != EWOULDBLOCK && errno != EINTR) return errno;
        if (std::chrono::steady_clock::now() >= end) return EWOULDBLOCK;
        std::this_thread::sleep_for(betweenTries);
    }
    return 0;
}

} // namespace

FileLock::FileLock(int directory, const std::string& name)
    : file(openat(directory, name.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600)) {
    failure = file ? waitForLock(file.get()) : errno;
}

} // namespace VK
