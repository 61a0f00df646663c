#include "vk/Architecture.h"

#include <sys/utsname.h>

namespace VK {

std::string architectureOf(const Root& root) {
    if (!root.isLive()) {
        const std::string contents = root.read("/proc/sys/kernel/arch").text;
        if (const std::string word = contents.substr(0, contents.find_first_of(" \t\r\n")); !word.empty()) return word;
    }
    utsname name{};
    return uname(&name) == 0 ? static_cast<const char*>(name.machine) : std::string();
}

} // namespace VK
