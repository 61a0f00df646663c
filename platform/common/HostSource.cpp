#include "vk/HostSource.h"

#include <cstdlib>

namespace VK {

namespace {

HostSource choose() {
    if (const char* tree = secure_getenv("VK_INSTRUMENTATION_TREE"); tree != nullptr && *tree != '\0')
        return {HostSource::Simulated, tree};
    if (const char* root = secure_getenv("VK_INSTRUMENTATION_ROOT"); root != nullptr && *root != '\0')
        return {HostSource::Snapshot, root};
    return {};
}

} // namespace

const HostSource& HostSource::current() {
    static const HostSource source = choose();
    return source;
}

} // namespace VK
