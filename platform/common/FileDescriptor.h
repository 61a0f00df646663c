#pragma once

#include <unistd.h>
#include <utility>

namespace VK {

/// Owns a descriptor; -1 is none.
class FileDescriptor {
public:
    explicit FileDescriptor(int descriptor = -1) noexcept : fd(descriptor) {}
    FileDescriptor(FileDescriptor&& other) noexcept : fd(other.release()) {}
    FileDescriptor& operator=(FileDescriptor&& other) noexcept {
        std::swap(fd, other.fd);
        return *this;
    }
    ~FileDescriptor() {
        if (fd >= 0) ::close(fd);
    }

    int get() const noexcept { return fd; }
    int release() noexcept { return std::exchange(fd, -1); }
    explicit operator bool() const noexcept { return fd >= 0; }

private:
    int fd;
};

} // namespace VK
