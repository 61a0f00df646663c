#include "vk/Root.h"

#include "common/RootWalk.h"
#include "vk/HostSource.h"
#include "vk/Kept.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <climits>
#include <cstdlib>
#include <dirent.h>
#include <fcntl.h>
#include <linux/openat2.h>
#include <memory>
#include <sys/stat.h>
#include <sys/syscall.h>

namespace VK {

namespace {

std::string absolute(const std::string& directory) {
    const std::unique_ptr<char, decltype(&std::free)> real(realpath(directory.c_str(), nullptr), &std::free);
    return real ? real.get() : directory;
}

/// openat2 takes no mode unless something may be made.
int openInRoot(int root, const std::string& path, int flags, mode_t mode) {
    open_how how{};
    how.flags = static_cast<decltype(how.flags)>(flags);
    how.mode = (flags & O_CREAT) != 0 ? mode : 0;
    how.resolve = RESOLVE_IN_ROOT | RESOLVE_NO_MAGICLINKS;
    const long fd = syscall(SYS_openat2, root, path.empty() ? "." : path.c_str(), &how, sizeof how);
    return fd >= 0 ? static_cast<int>(fd) : -errno;
}

/// Old kernels and system call filters do not have openat2; it also gives up when a directory is renamed meanwhile.
bool mustWalk(int error) {
    return error == ENOSYS || error == EPERM || error == EAGAIN;
}

FileDescriptor openRoot(const std::string& directory) {
    return FileDescriptor(::open(directory.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
}

Root::Contents failed(int error) {
    noteShortage(error);
    Root::Contents contents;
    contents.error = error;
    return contents;
}

ssize_t readSome(int fd, char* to, std::size_t size) {
    ssize_t count{};
    do {
        count = ::read(fd, to, size);
    } while (count < 0 && errno == EINTR);
    return count;
}

/// 0 for what may be read without waiting, else the errno value.
int checkRegular(int fd) {
    struct stat status {};
    if (fstat(fd, &status) != 0) return errno;
    if (S_ISDIR(status.st_mode)) return EISDIR;
    return S_ISREG(status.st_mode) ? 0 : EINVAL;
}

Root::Contents readAll(int fd, std::size_t limit) {
    Root::Contents contents;
    std::array<char, 4096> chunk;
    for (;;) {
        const ssize_t count = readSome(fd, chunk.data(), chunk.size());
        if (count < 0) return failed(errno);
        if (count == 0) return contents;
        const std::size_t room = limit - contents.text.size();
        const std::size_t length = std::min(static_cast<std::size_t>(count), room);
        contents.text.append(chunk.data(), length);
        contents.truncated = length < static_cast<std::size_t>(count);
        if (contents.truncated) return contents;
    }
}

} // namespace

Root::Root(const std::string& where, bool isSnapshot)
    : directory(absolute(where)), live(!isSnapshot && directory == "/") {}

const Root& Root::host() {
    const HostSource& source = HostSource::current();
    static const Root root = source.kind == HostSource::Snapshot ? Root(source.location, true) : Root("/");
    return root;
}

Root Root::recordedIn(Record& record) const {
    Root root = *this;
    root.asked = &record;
    return root;
}

int Root::open(const std::string& path, int flags, mode_t mode) const {
    const int opened = openBelow(path, flags, mode);
    if (opened < 0) noteShortage(-opened);
    return opened;
}

int Root::openBelow(const std::string& path, int flags, mode_t mode) const {
    if (path.find('\0') != std::string::npos) return -EINVAL;
    flags |= O_CLOEXEC | ((flags & O_PATH) != 0 ? 0 : O_NOCTTY); // openat2 refuses what O_PATH does not use
    if (live) {
        const int fd = ::open(path.rfind('/', 0) == 0 ? path.c_str() : ("/" + path).c_str(), flags, mode);
        return fd >= 0 ? fd : -errno;
    }
    FileDescriptor root = openRoot(directory);
    if (!root) return -errno;
    const int fd = openInRoot(root.get(), path, flags, mode);
    if (fd >= 0 || !mustWalk(-fd)) return fd;

    RootWalk walk(std::move(root));
    const int error = walk.walk(path, (flags & O_NOFOLLOW) == 0);
    if (error != 0 && !(walk.onlyLastNameIsMissing() && (flags & O_CREAT) != 0)) return -error;
    return walk.open(flags, mode);
}

Root::Contents Root::read(const std::string& path, std::size_t limit) const {
    if (asked != nullptr) asked->read.push_back(path);
    const int opened = open(path, O_RDONLY | O_NONBLOCK);
    if (opened < 0) return failed(-opened);
    const FileDescriptor fd(opened);
    if (const int error = checkRegular(fd.get()); error != 0) return failed(error);
    return readAll(fd.get(), limit);
}

Root::Contents Root::readLink(const std::string& path) const {
    if (asked != nullptr) asked->followed.push_back(path);
    const int opened = open(path, O_PATH | O_NOFOLLOW);
    if (opened < 0) return failed(-opened);
    const FileDescriptor fd(opened);
    struct stat status {};
    if (fstat(fd.get(), &status) != 0) return failed(errno);
    if (!S_ISLNK(status.st_mode)) return failed(EINVAL);
    std::array<char, PATH_MAX> target;
    const ssize_t length = readlinkat(fd.get(), "", target.data(), target.size());
    if (length < 0) return failed(errno);
    Contents contents;
    contents.text.assign(target.data(), static_cast<std::size_t>(length));
    return contents;
}

Root::Contents Root::resolve(const std::string& path) const {
    if (asked != nullptr) asked->followed.push_back(path);
    FileDescriptor root = openRoot(directory);
    if (!root) return failed(errno);
    RootWalk walk(std::move(root));
    if (const int error = walk.walk(path, true); error != 0) return failed(error);
    Contents contents;
    contents.text = walk.path();
    return contents;
}

Root::Names Root::list(const std::string& path) const {
    Names result;
    const int opened = open(path, O_RDONLY | O_DIRECTORY);
    if (opened < 0) {
        result.error = -opened;
        return result;
    }
    FileDescriptor fd(opened);
    const std::unique_ptr<DIR, int (*)(DIR*)> stream(fdopendir(fd.get()), &closedir);
    if (!stream) {
        noteShortage(errno);
        result.error = errno;
        return result;
    }
    fd.release();
    errno = 0;
    while (const dirent* entry = readdir(stream.get())) {
        const std::string name = static_cast<const char*>(entry->d_name);
        if (name != "." && name != "..") result.names.push_back(name);
        errno = 0;
    }
    result.error = errno;
    noteShortage(result.error);
    if (!result) result.names.clear();
    std::sort(result.names.begin(), result.names.end());
    return result;
}

bool Root::exists(const std::string& path) const {
    return bool(FileDescriptor(open(path, O_PATH)));
}

} // namespace VK
