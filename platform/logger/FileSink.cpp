#include "logger/FileSink.h"

#include "logger/Write.h"
#include "vk/FileDescriptor.h"

#include <atomic>
#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>

namespace NVLog {

namespace {

using VK::FileDescriptor;

struct FileIdentity {
    dev_t device = 0;
    ino_t inode = 0;

    bool operator==(const FileIdentity& other) const { return device == other.device && inode == other.inode; }
};

FileIdentity identity(const struct stat& status) {
    return {status.st_dev, status.st_ino};
}

bool isFile(int descriptor, const FileIdentity& file) noexcept {
    struct stat status {};
    return descriptor >= 0 && fstat(descriptor, &status) == 0 && identity(status) == file;
}

/// The descriptor that is kept open. Nothing waits for a lock here: whoever finds `changing` set opens the file for
/// itself, so that neither threads nor the child of a fork can hang.
struct KeptDescriptor {
    std::atomic<int> number{-1};
    std::atomic_flag changing = ATOMIC_FLAG_INIT;
    FileIdentity file; ///< belongs to who set `changing`

    ~KeptDescriptor() {
        const int descriptor = number.exchange(-1);
        if (isFile(descriptor, file)) ::close(descriptor);
    }
};

KeptDescriptor kept;

FileDescriptor openFile(const char* path) noexcept {
    // O_NONBLOCK, because a log call must not wait for a pipe's reader.
    FileDescriptor opened(
        ::open(path, O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC | O_NOCTTY | O_NONBLOCK, S_IRUSR | S_IWUSR | S_IRGRP));
    if (!opened || opened.get() > STDERR_FILENO) return opened;
    // A process without standard streams must not find its output in the log.
    return FileDescriptor(fcntl(opened.get(), F_DUPFD_CLOEXEC, STDERR_FILENO + 1));
}

bool isOpenAs(int descriptor, const char* path) noexcept {
    struct stat status {};
    return stat(path, &status) == 0 && isFile(descriptor, identity(status));
}

/// Puts the new file in the kept one's place under the same number: another thread that is about to write there then
/// writes to one of the two, never to a stranger's file.
void keep(FileDescriptor opened) noexcept {
    struct stat status {};
    if (fstat(opened.get(), &status) != 0) return;
    const int number = kept.number.load();
    if (isFile(number, kept.file)) {
        while (dup3(opened.get(), number, O_CLOEXEC) < 0 && (errno == EINTR || errno == EBUSY)) {
        }
    } else {
        // Also when somebody closed it behind our back, as daemons do: the number may be another's by now.
        kept.number = opened.release();
    }
    kept.file = identity(status);
}

} // namespace

bool appendToFile(const char* path, std::string_view line) noexcept {
    if (const int number = kept.number.load(); isOpenAs(number, path)) return writeLine(number, line);
    FileDescriptor opened = openFile(path);
    if (!opened) return false;
    const bool written = writeLine(opened.get(), line);
    if (!kept.changing.test_and_set()) {
        keep(std::move(opened));
        kept.changing.clear();
    }
    return written;
}

} // namespace NVLog
