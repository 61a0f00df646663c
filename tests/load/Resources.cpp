#include "load/Resources.h"

#include "support/OpenDescriptors.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <fstream>

#include <malloc.h>
#include <unistd.h>

namespace load {
namespace {

constexpr char tunables[] = "GLIBC_TUNABLES";
constexpr char cachesOff[] = "glibc.malloc.tcache_count=0";

bool cachesAreOff() {
    const char* const set = std::getenv(tunables);
    return set != nullptr && std::strstr(set, cachesOff) != nullptr;
}

/// Starts this program again with malloc's caches off, which can only be chosen before a program starts. Runs before
/// anything else that is constructed here.
__attribute__((constructor(101))) void turnCachesOff(int, char** words, char**) {
    if (!memoryTells() || std::getenv(tunables) != nullptr) return;
    setenv(tunables, cachesOff, 1);
    execv("/proc/self/exe", words);
}

} // namespace

bool memoryTells() {
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
    return false;
#else
    return true;
#endif
}

bool heapTells() {
    return memoryTells() && cachesAreOff();
}

Resources Resources::now() {
    Resources found;
    if (heapTells()) {
        const struct mallinfo2 info = mallinfo2();
        found.heap = info.uordblks + info.hblkhd;
    }
    if (memoryTells()) {
        std::size_t pages = 0;
        std::ifstream("/proc/self/statm") >> pages >> pages; // the second number
        found.resident = pages * static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
    }
    found.descriptors = support::openDescriptors();
    return found;
}

std::vector<std::string> mappedLibraries() {
    std::vector<std::string> found;
    std::ifstream maps("/proc/self/maps");
    for (std::string line; std::getline(maps, line);) {
        const std::size_t slash = line.rfind('/');
        if (slash == std::string::npos) continue;
        const std::string name = line.substr(slash + 1);
        const bool ours = name.rfind("libvk", 0) == 0 || name.rfind("libnvlog", 0) == 0;
        if (ours && std::find(found.begin(), found.end(), name) == found.end()) found.push_back(name);
    }
    return found;
}

} // namespace load
