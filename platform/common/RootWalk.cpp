#include "common/RootWalk.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <climits>
#include <fcntl.h>
#include <sys/stat.h>

namespace VK {

namespace {

constexpr unsigned int maxLinks = 40; // as the kernel has it

} // namespace

void RootWalk::defer(const std::string& path) {
    // A final slash leaves an empty last name, which asks for a directory.
    std::vector<std::string> names;
    std::string::size_type begin = 0;
    while (begin <= path.size()) {
        const auto end = std::min(path.find('/', begin), path.size());
        names.push_back(path.substr(begin, end - begin));
        begin = end + 1;
    }
    pending.insert(pending.end(), names.rbegin(), names.rend());
}

int RootWalk::follow(const FileDescriptor& link) {
    if (followed.size() > maxLinks) return ELOOP;
    std::array<char, PATH_MAX> target{};
    const ssize_t length = readlinkat(link.get(), "", target.data(), target.size());
    if (length < 0) return errno;
    if (length == 0) return ENOENT;
    if (static_cast<std::size_t>(length) == target.size()) return ENAMETOOLONG;
    if (target[0] == '/') steps.clear();
    defer(std::string(target.data(), static_cast<std::size_t>(length)));
    return 0;
}

int RootWalk::enter(const std::string& name, bool followLink) {
    FileDescriptor fd(openat(top(), name.c_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC));
    if (!fd) {
        const int error = errno;
        if (error == ENOENT) absent = below(name);
        if (error == ENOENT && pending.empty()) missing = name;
        return error;
    }
    struct stat status {};
    if (fstat(fd.get(), &status) != 0) return errno;
    if (S_ISLNK(status.st_mode) && (followLink || !pending.empty())) {
        followed.push_back(below(name));
        return follow(fd);
    }
    if (!pending.empty() && !S_ISDIR(status.st_mode)) return ENOTDIR;
    steps.push_back({name, std::move(fd)});
    return 0;
}

int RootWalk::walk(const std::string& path, bool followLast) {
    if (path.find('\0') != std::string::npos) return EINVAL;
    defer(path);
    while (!pending.empty()) {
        const std::string name = std::move(pending.back());
        pending.pop_back();
        if (name.empty() || name == ".") continue;
        if (name == "..") {
            if (!steps.empty()) steps.pop_back();
            continue;
        }
        if (const int error = enter(name, followLast); error != 0) return error;
    }
    return 0;
}

int RootWalk::open(int flags, mode_t mode) const {
    int parent = top();
    std::string name = missing;
    if (name.empty() && !steps.empty()) {
        parent = steps.size() > 1 ? steps[steps.size() - 2].fd.get() : root.get();
        name = steps.back().name;
    }
    // Every link has been followed by now: one that shows up since is not.
    const int fd = openat(parent, name.empty() ? "." : name.c_str(), flags | O_NOFOLLOW | O_CLOEXEC, mode);
    return fd >= 0 ? fd : -errno;
}

std::string RootWalk::path() const {
    std::string text;
    for (const Step& step : steps) text += "/" + step.name;
    return text.empty() ? "/" : text;
}

std::string RootWalk::below(const std::string& name) const {
    const std::string above = path();
    return (above == "/" ? above : above + "/") + name;
}

} // namespace VK
