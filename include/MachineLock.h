#pragma once

#include "vk/FileDescriptor.h"

#include <mutex>
#include <string>
#include <sys/types.h>

namespace VK {

/// Held by one at a time on this machine, for what must not run twice at once: by one thread of this process and, where
/// its file can be had, by one process. A thread holds one at a time, of whatever name.
///
/// Only a file that nobody but root can open, replace or keep locked is used; otherwise anybody could stop the holders
/// of the rights. The lock is a POSIX record lock: neither commands nor children of a fork inherit it, it ends with its
/// process, and the file, which stays, says nothing of who holds it.
class MachineLock {
public:
    /// Waits until the lock is free, without limit. The file `name` of the directory is made, for root alone, where it
    /// is missing. Where that cannot be done, or others than root may write to the directory, the lock is one among the
    /// threads of this process only.
    explicit MachineLock(const std::string& name, const std::string& directory = "/run");
    ~MachineLock();
    MachineLock(const MachineLock&) = delete;
    MachineLock& operator=(const MachineLock&) = delete;

    /// Whether other processes are kept out as well.
    bool keepsProcessesOut() const { return static_cast<bool>(file); }

private:
    std::unique_lock<std::mutex> threads;
    FileDescriptor file;
    pid_t holder; ///< a child of a fork has a copy of this object, but not the lock
};

} // namespace VK
