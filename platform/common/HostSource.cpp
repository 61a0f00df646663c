#include "vk/HostSource.h"

#include <cstdlib>
#include <filesystem>

namespace VK {

namespace {

/// An object manager changes its working directory when it becomes a daemon, and that must not change the host. The
/// path as it is where the working directory cannot be found out.
std::string absolute(const char* path) {
    std::error_code error;
    const std::filesystem::path found = std::filesystem::absolute(path, error);
    return error ? path : found.string();
}

HostSource choose() {
    if (const char* tree = secure_getenv("VK_INSTRUMENTATION_TREE"); tree != nullptr && *tree != '\0')
        return {HostSource::Simulated, absolute(tree)};
    if (const char* root = secure_getenv("VK_INSTRUMENTATION_ROOT"); root != nullptr && *root != '\0')
        return {HostSource::Snapshot, absolute(root)};
    return {};
}

} // namespace

const HostSource& HostSource::current() {
    static const HostSource source = choose();
    return source;
}

} // namespace VK
