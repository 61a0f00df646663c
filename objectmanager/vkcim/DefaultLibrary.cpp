#include "objectmanager/vkcim/DefaultLibrary.h"

#include <filesystem>

namespace vkcim {

namespace fs = std::filesystem;

std::string defaultLibrary(const std::string& directory) {
    constexpr const char* name = "libvknabaseserverprofileprovider.so.1";
    const fs::path beside = (fs::path(directory) / "../lib" / name).lexically_normal();
    const fs::path installed = (fs::path(directory) / VKCIM_BINDIR_TO_LIBDIR / name).lexically_normal();
    std::error_code ignored;
    return !fs::exists(beside, ignored) && fs::exists(installed, ignored) ? installed : beside;
}

std::string libraryPath(const std::string& name) {
    std::error_code ignored;
    return name.find('/') == std::string::npos && fs::exists(name, ignored) ? "./" + name : name;
}

std::string programDirectory() {
    std::error_code error;
    const fs::path program = fs::read_symlink("/proc/self/exe", error);
    return error ? fs::path() : program.parent_path();
}

} // namespace vkcim
