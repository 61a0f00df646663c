#include "include/MachineLock.h"

#include <cerrno>
#include <fcntl.h>
#include <new>
#include <pthread.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace VK {

namespace {

/// One for all names. Closing any descriptor of a file ends the process's record locks on it: so this process may hold
/// no two open at a time.
std::mutex amongThreads;

/// The thread that held it may not exist in the child.
[[maybe_unused]] const int watched = pthread_atfork(nullptr, nullptr, [] { new (&amongThreads) std::mutex; });

bool onlyRootWrites(int directory) {
    struct stat status {};
    return fstat(directory, &status) == 0 && status.st_uid == 0 && (status.st_mode & (S_IWGRP | S_IWOTH)) == 0;
}

/// A descriptor, or -1. A cancellation waits for the next chance while it is closed: close is one, and a destructor
/// that a thread is unwound from ends the process.
struct Closing {
    ~Closing() {
        int before = PTHREAD_CANCEL_ENABLE;
        pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, &before);
        ::close(descriptor);
        pthread_setcancelstate(before, nullptr);
    }
    int descriptor;
};

/// -1 where it may not be used.
int openLockFile(const std::string& directory, const std::string& name) {
    const Closing where{::open(directory.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)};
    if (where.descriptor < 0 || !onlyRootWrites(where.descriptor)) return -1;
    return openat(where.descriptor, name.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600);
}

bool waitForLock(int file) {
    struct flock whole {};
    whole.l_type = F_WRLCK;
    whole.l_whence = SEEK_SET;
    int result = 0;
    do result = fcntl(file, F_SETLKW, &whole);
    while (result != 0 && errno == EINTR);
    return result == 0;
}

} // namespace

MachineLock::MachineLock(const std::string& name, const std::string& directory)
    : threads(amongThreads), holder(getpid()) {
    Closing opened{openLockFile(directory, name)};
    if (opened.descriptor >= 0 && waitForLock(opened.descriptor)) file = std::exchange(opened.descriptor, -1);
}

MachineLock::~MachineLock() {
    const Closing closed{file}; // before other threads go on: members are destroyed later
    if (getpid() != holder) threads.release();
}

} // namespace VK
