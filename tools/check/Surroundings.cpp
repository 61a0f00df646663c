#include "tools/check/Surroundings.h"

#include "common/Text.h"
#include "logger/LogLine.h"
#include "vk/FileDescriptor.h"

#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <linux/capability.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace check {

using VK::Root;

namespace {

/// Whether what is at the path, links followed, is of that type and lets us do that.
bool allows(const Root& root, const std::string& path, mode_t type, int mode) {
    const Root::Contents real = root.resolve(path);
    if (!real) return false;
    const std::string place = root.getDirectory() + real.text;
    struct stat status {};
    return stat(place.c_str(), &status) == 0 && (status.st_mode & S_IFMT) == type && access(place.c_str(), mode) == 0;
}

/// Links count, wherever they lead.
bool isAnything(const Root& root, const std::string& path) {
    return bool(VK::FileDescriptor(root.open(path, O_PATH | O_NOFOLLOW)));
}

} // namespace

std::optional<std::string> problemOf(const Root& root, const std::string& path) {
    const int error = root.read(path, 1).error;
    if (error == 0) return std::nullopt;
    if (error == ENOENT) return "not there";
    return error == EACCES ? "no right to read it" : VK::errorText(error);
}

bool isEmpty(const Root& root, const std::string& path) {
    return VK::trimmed(root.read(path).text).empty();
}

bool isProgram(const Root& root, const std::string& path) {
    return allows(root, path, S_IFREG, X_OK);
}

std::optional<std::string> findCommand(const Root& root, const std::string& name) {
    const char* const found = std::getenv("PATH");
    std::string directories = found != nullptr ? found : "/usr/sbin:/usr/bin:/sbin:/bin";
    for (directories += ':'; !directories.empty(); directories.erase(0, directories.find(':') + 1)) {
        const std::string directory = directories.substr(0, directories.find(':'));
        if (!directory.empty() && isProgram(root, directory + "/" + name)) return directory + "/" + name;
    }
    return std::nullopt;
}

bool mayWriteIn(const Root& root, std::string directory) {
    while (!directory.empty() && !isAnything(root, directory)) directory.erase(directory.rfind('/'));
    return allows(root, directory, S_IFDIR, W_OK | X_OK);
}

bool maySetClock() {
    __user_cap_header_struct header = {_LINUX_CAPABILITY_VERSION_3, 0};
    __user_cap_data_struct data[_LINUX_CAPABILITY_U32S_3] = {};
    return syscall(SYS_capget, &header, data) == 0 && (data[0].effective >> CAP_SYS_TIME & 1) != 0;
}

} // namespace check
