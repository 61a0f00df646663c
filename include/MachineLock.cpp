#include "include/MachineLock.h"

#include <cerrno>
#include <fcntl.h>
#include <new>
#include <pthread.h>
#include <sys/stat.h>
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

/// None where it may not be used.
FileDescriptor openLockFile(const std::string& directory, const std::string& name) {
    const FileDescriptor where(::open(directory.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (!where || !onlyRootWrites(where.get())) return FileDescriptor();
    return FileDescriptor(openat(where.get(), name.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600));
}

bool waitForLock(int file) {
    struct flock whole {};
    whole.l_type = F_WRLCK;
    whole.l_whence = SEEK_SET;
    int result{};
    do result = fcntl(file, F_SETLKW, &whole);
    while (result != 0 && errno == EINTR);
    return result == 0;
}

} // namespace

MachineLock::MachineLock(const std::string& name, const std::string& directory)
    : threads(amongThreads), holder(getpid()) {
    FileDescriptor opened = openLockFile(directory, name);
    if (opened && waitForLock(opened.get())) file = std::move(opened);
}

MachineLock::~MachineLock() {
    const FileDescriptor closed = std::move(file); // before other threads go on: members are destroyed later
    if (getpid() != holder) threads.release();
}

} // namespace VK
