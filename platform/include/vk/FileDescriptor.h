#pragma once

#include <pthread.h>
#include <unistd.h>
#include <utility>

namespace VK {

/// Owns a file descriptor and closes it at its end; -1 is none. It may be moved, not copied. Nothing is thrown.
class FileDescriptor {
public:
    /// Takes over `descriptor`, as open(2) and its like return it: -1 for a failure is none.
    explicit FileDescriptor(int descriptor = -1) noexcept : fd(descriptor) {}
    FileDescriptor(FileDescriptor&& other) noexcept : fd(other.release()) {}
    FileDescriptor& operator=(FileDescriptor&& other) noexcept {
        std::swap(fd, other.fd);
        return *this;
    }
    ~FileDescriptor() {
        if (fd >= 0) closeWithoutEnd(fd);
    }

    /// The descriptor, or -1; it stays owned.
    int get() const noexcept { return fd; }
    /// The descriptor, or -1, which the caller closes from now on.
    int release() noexcept { return std::exchange(fd, -1); }
    /// Whether there is a descriptor.
    explicit operator bool() const noexcept { return fd >= 0; }

private:
    /// A cancellation waits for the next chance: close is one, and a destructor that a thread is unwound from ends the
    /// process.
    static void closeWithoutEnd(int descriptor) noexcept {
        int before = PTHREAD_CANCEL_ENABLE;
        pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, &before);
        ::close(descriptor);
        pthread_setcancelstate(before, nullptr);
    }

    int fd;
};

} // namespace VK
