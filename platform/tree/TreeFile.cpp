#include "tree/TreeFile.h"

#include "common/AtomicFile.h"
#include "common/FileLock.h"
#include "logger/LogLine.h"
#include "vk/FileDescriptor.h"
#include "vk/Kept.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <memory>

namespace VK::Tree {

namespace {

TreeFileContents unusable(int error) {
    TreeFileContents contents;
    noteShortage(error);
    contents.error = error;
    contents.problem = errorText(error);
    return contents;
}

/// Up to `limit` bytes; 0 or the errno value.
int readBytes(int fd, std::size_t limit, std::string& text) {
    while (text.size() < limit) {
        const std::size_t before = text.size();
        text.resize(std::min(limit, before + 65536));
        const ssize_t count = ::read(fd, text.data() + before, text.size() - before);
        text.resize(before + (count > 0 ? static_cast<std::size_t>(count) : 0));
        if (count == 0) break;
        if (count < 0 && errno != EINTR) return errno;
    }
    return 0;
}

std::string withoutLinks(const std::string& file) {
    const std::unique_ptr<char, decltype(&std::free)> real(realpath(file.c_str(), nullptr), &std::free);
    return real ? real.get() : file;
}

} // namespace

TreeFileContents readTreeFile(const std::string& file, std::size_t limit) {
    const FileDescriptor fd(::open(file.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    if (!fd) return unusable(errno);
    TreeFileContents contents;
    if (fstat(fd.get(), &contents.status) != 0) return unusable(errno);
    if (!S_ISREG(contents.status.st_mode)) {
        contents.problem = "not a regular file";
    } else if (contents.status.st_size > static_cast<off_t>(limit)) {
        contents.problem = "larger than " + std::to_string(limit) + " bytes";
    } else if (const int error = readBytes(fd.get(), limit, contents.text); error != 0) {
        return unusable(error);
    }
    return contents;
}

std::string replaceTreeFile(const std::string& file, std::size_t limit, const TreeChange& change) {
    const std::string real = withoutLinks(file);
    const FileLock lock(AT_FDCWD, real + ".lock");
    if (lock.error() != 0) return "cannot lock " + real + ".lock: " + errorText(lock.error());
    const TreeFileContents now = readTreeFile(real, limit);
    if (!now.problem.empty()) return now.problem;
    std::string problem;
    const std::string text = change(now.text, problem);
    if (!problem.empty()) return problem;
    if (text == now.text) return {};
    if (text.size() > limit) return "it would be larger than " + std::to_string(limit) + " bytes";
    const std::size_t slash = real.rfind('/') + 1;
    const FileDescriptor directory(
        ::open(slash == 0 ? "." : real.substr(0, slash).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (!directory) return errorText(errno);
    const FileOwner owner{now.status.st_mode & 07777, now.status.st_uid, now.status.st_gid};
    const int error = replaceFile(directory.get(), real.substr(slash), text, owner);
    return error == 0 ? std::string() : "cannot replace it: " + errorText(error);
}

} // namespace VK::Tree
