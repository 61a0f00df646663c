#include "common/AtomicFile.h"

#include "vk/FileDescriptor.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <ctime>
#include <fcntl.h>
#include <pthread.h>
#include <sys/stat.h>
#include <unistd.h>

namespace VK {

namespace {

/// The name of what is not in place yet. One left over from a crash is overwritten.
std::string besides(const std::string& name) {
    return "." + name + ".vk-new";
}

/// Keeps the signal of a write beyond the file size limit from the process, which it would end.
class SizeLimitSignal {
public:
    SizeLimitSignal() noexcept {
        sigemptyset(&ours);
        sigaddset(&ours, SIGXFSZ);
        pthread_sigmask(SIG_BLOCK, &ours, &before);
    }
    ~SizeLimitSignal() { pthread_sigmask(SIG_SETMASK, &before, nullptr); }
    SizeLimitSignal(const SizeLimitSignal&) = delete;
    SizeLimitSignal& operator=(const SizeLimitSignal&) = delete;

    /// Takes back the signal that the failed write sent to this thread, unless the thread had it blocked anyway.
    void takeBack() const noexcept {
        if (sigismember(&before, SIGXFSZ) == 1) return;
        const timespec atOnce{};
        while (sigtimedwait(&ours, nullptr, &atOnce) < 0 && errno == EINTR) {
        }
    }

private:
    sigset_t ours{};
    sigset_t before{};
};

int writeAll(int fd, const std::string& bytes) {
    const SizeLimitSignal signal;
    std::size_t done = 0;
    while (done < bytes.size()) {
        const ssize_t count = ::write(fd, bytes.data() + done, bytes.size() - done);
        if (count >= 0) {
            done += static_cast<std::size_t>(count);
        } else if (const int error = errno; error != EINTR) {
            if (error == EFBIG) signal.takeBack();
            return error;
        }
    }
    return 0;
}

int fill(int fd, const std::string& bytes, const FileOwner& owner) {
    if (const int error = writeAll(fd, bytes); error != 0) return error;
    // Giving a file away takes a privilege; without it the file stays ours.
    if (fchown(fd, owner.user, owner.group) != 0 && errno != EPERM) return errno;
    if (fchmod(fd, owner.mode) != 0) return errno;
    return fsync(fd) == 0 ? 0 : errno;
}

int putInPlace(int directory, const std::string& from, const std::string& to) {
    if (renameat(directory, from.c_str(), directory, to.c_str()) != 0) return errno;
    // The rename is done: a directory that cannot be synchronised does not undo it.
    fsync(directory);
    return 0;
}

/// Calls `make` with a name beside `name`, and puts what it made there in the place of `name`.
template <class Make>
int replace(int directory, const std::string& name, const Make& make) {
    const std::string fresh = besides(name);
    if (unlinkat(directory, fresh.c_str(), 0) != 0 && errno != ENOENT) return errno;
    int error = make(fresh.c_str());
    if (error == 0) error = putInPlace(directory, fresh, name);
    // The new name is still there after a failure, and when both are one file: renaming does nothing then.
    unlinkat(directory, fresh.c_str(), 0);
    return error;
}

} // namespace

int replaceFile(int directory, const std::string& name, const std::string& bytes, const FileOwner& owner) {
    return replace(directory, name, [&](const char* fresh) {
        const FileDescriptor fd(openat(directory, fresh, O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, 0600));
        return fd ? fill(fd.get(), bytes, owner) : errno;
    });
}

int replaceLink(int directory, const std::string& name, const std::string& target) {
    return replace(directory, name,
                   [&](const char* fresh) { return symlinkat(target.c_str(), directory, fresh) == 0 ? 0 : errno; });
}

int replaceByLinking(int directory, const std::string& name, int from) {
    return replace(directory, name,
                   [&](const char* fresh) { return linkat(from, name.c_str(), directory, fresh, 0) == 0 ? 0 : errno; });
}

int removeFile(int directory, const std::string& name) {
    if (unlinkat(directory, name.c_str(), 0) != 0) return errno == ENOENT ? 0 : errno;
    fsync(directory);
    return 0;
}

} // namespace VK
