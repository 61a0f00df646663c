#pragma once

#include "vk/FileDescriptor.h"

#include <string>

namespace VK {

/// Holds a lock among processes and threads: the file `name` of a directory, made where it is missing, and left there.
class FileLock {
public:
    /// Waits for the lock, ten seconds at most. `directory` may be AT_FDCWD.
    FileLock(int directory, const std::string& name);

    /// 0 while the lock is held, else the errno value; EWOULDBLOCK when somebody else kept it.
    int error() const { return failure; }

private:
    FileDescriptor file;
    int failure = 0;
};

} // namespace VK
