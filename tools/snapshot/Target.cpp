#include "tools/snapshot/Target.h"

#include "logger/LogLine.h"

#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace snapshot {

namespace fs = std::filesystem;

namespace {

constexpr mode_t closedDirectory = 0700;
constexpr mode_t closedFile = 0600;

/// A final slash would follow a link.
fs::path withoutFinalSlash(const fs::path& path) {
    return path.has_filename() || !path.has_relative_path() ? path : withoutFinalSlash(path.parent_path());
}

/// What is before the last slash, and what is behind it.
std::pair<std::string, std::string> split(const std::string& name) {
    const std::size_t slash = name.rfind('/');
    return slash == std::string::npos ? std::pair(std::string(), name)
                                      : std::pair(name.substr(0, slash), name.substr(slash + 1));
}

VK::FileDescriptor openDirectory(int at, const std::string& name) {
    return VK::FileDescriptor(openat(at, name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
}

/// A link is not followed: it may be somebody else's.
bool othersUse(const fs::path& directory) {
    struct stat status {};
    return lstat(directory.c_str(), &status) == 0 && S_ISDIR(status.st_mode) &&
           (status.st_uid != geteuid() || (status.st_mode & forOthers) != 0);
}

bool writeAll(int fd, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t count = ::write(fd, bytes.data(), bytes.size());
        if (count < 0 && errno != EINTR) return false;
        bytes.remove_prefix(count > 0 ? static_cast<std::size_t>(count) : 0);
    }
    return true;
}

} // namespace

Failure::Failure(const fs::path& path, int error) : std::runtime_error(path.string() + ": " + VK::errorText(error)) {}

Target::Target(const fs::path& directory) : path(withoutFinalSlash(directory)) {
    try {
        makeMissing(path);
        if (othersUse(path)) makeOwnBelow();
        openItself();
    } catch (const Failure&) {
        removeMade();
        throw;
    }
}

void Target::makeMissing(const fs::path& directory) {
    std::error_code error;
    if (directory.empty() || fs::symlink_status(directory, error).type() != fs::file_type::not_found) return;
    makeMissing(directory.parent_path());
    if (mkdir(directory.c_str(), closedDirectory) != 0) throw Failure(directory, errno);
    made.push_back(directory);
}

/// Under a name that nobody can have taken before.
void Target::makeOwnBelow() {
    std::string own = path / "vk-host-snapshot-XXXXXX";
    if (mkdtemp(own.data()) == nullptr) throw Failure(path, errno);
    path = own;
    made.push_back(path);
}

/// Nobody else may have put anything there, be able to do so, or be able to read it: in a directory that others use,
/// they may have put another in place of the one made.
void Target::openItself() {
    VK::FileDescriptor fd = openDirectory(AT_FDCWD, path);
    struct stat status {};
    if (!fd || fstat(fd.get(), &status) != 0) throw Failure(path, errno);
    if (status.st_uid != geteuid() || (status.st_mode & forOthers) != 0)
        throw Failure(path.string() + " is somebody else's");
    std::error_code error;
    if (!fs::is_empty(path, error) || error)
        throw Failure(path.string() + " is not empty: name one in it that is not there yet");
    directories.emplace(std::string(), std::move(fd));
}

void Target::write(const std::string& name, std::string_view bytes) {
    const int flags = O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC;
    const auto [parent, own] = split(name);
    const VK::FileDescriptor file(openat(open(parent, name), own.c_str(), flags, closedFile));
    if (!file) fail(name);
    entries.push_back(name);
    if (!writeAll(file.get(), bytes)) fail(name);
}

void Target::link(const std::string& name, const std::string& target) {
    const auto [parent, own] = split(name);
    if (symlinkat(target.c_str(), open(parent, name), own.c_str()) != 0) fail(name);
    entries.push_back(name);
}

/// The directory below it for that name, made where it is missing.
int Target::open(const std::string& directory, const std::string& forName) {
    const auto found = directories.find(directory);
    if (found != directories.end()) return found->second.get();
    const auto [above, own] = split(directory);
    const int parent = open(above, forName);
    if (mkdirat(parent, own.c_str(), closedDirectory) != 0) fail(forName);
    VK::FileDescriptor& fd = directories[directory];
    fd = openDirectory(parent, own);
    if (!fd) fail(forName);
    return fd.get();
}

void Target::fail(const std::string& name) const {
    throw Failure(path / name, errno);
}

bool Target::remove() {
    bool removed = true;
    const auto take = [&](const std::string& name, int flags) {
        const auto [directory, own] = split(name);
        removed = unlinkat(directories[directory].get(), own.c_str(), flags) == 0 && removed;
    };
    for (const std::string& name : entries) take(name, 0);
    // In alphabetical order a directory comes before its entries.
    for (auto each = directories.rbegin(); each != directories.rend(); ++each)
        if (!each->first.empty()) take(each->first, AT_REMOVEDIR);
    return removeMade() && removed;
}

bool Target::removeMade() {
    while (!made.empty() && rmdir(made.back().c_str()) == 0) made.pop_back();
    return made.empty();
}

} // namespace snapshot
