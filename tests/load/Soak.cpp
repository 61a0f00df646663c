#include "load/Requests.h"
#include "load/Resources.h"
#include "load/Runs.h"

#include <algorithm>
#include <cstdio>
#include <stdexcept>

namespace load {
namespace {

// What one request keeps to itself for a moment; a leak of the smallest block at every hundredth request of the short
// form would come to more.
constexpr std::size_t heapTolerance = 1024;
// The allocator's own: pages that it keeps or has not yet given back.
constexpr std::size_t residentTolerance = 512 * 1024;

} // namespace

void runSoak(const std::string& library, std::size_t requests) {
    om::ObjectManager manager(library, "BaseServerProvider", "root/cimv2");
    const std::vector<Kind> kinds = allKinds(manager);
    Picker picker(kinds, 1);
    const std::size_t warm = requests / 10;
    Resources start;
    Resources most;
    for (std::size_t asked = 0; asked < requests; ++asked) {
        if (asked == warm) start = most = Resources::now();
        const Kind& kind = picker.next();
        if (ask(manager, kind.request) != kind.answer) throw std::runtime_error(kind.name + " answered differently");
        if (asked < warm || asked % 256 != 0) continue;
        const Resources now = Resources::now();
        most.resident = std::max(most.resident, now.resident);
        most.heap = std::max(most.heap, now.heap);
        most.descriptors = std::max(most.descriptors, now.descriptors);
    }
    std::printf("soak: %zu requests of %zu kinds; descriptors %zu, at most %zu", requests, kinds.size(),
                start.descriptors, most.descriptors);
    if (memoryTells())
        std::printf("; heap %zu bytes, at most %zu more; resident %zu bytes, at most %zu more", start.heap,
                    most.heap - start.heap, start.resident, most.resident - start.resident);
    std::printf("\n");
    if (most.descriptors > start.descriptors) throw std::runtime_error("descriptors are left open");
    if (most.heap > start.heap + heapTolerance) throw std::runtime_error("memory is not freed");
    if (most.resident > start.resident + residentTolerance) throw std::runtime_error("resident memory grows");
}

} // namespace load
