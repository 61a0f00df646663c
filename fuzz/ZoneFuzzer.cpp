#include "instrumentation/ZoneFile.h"

#include <cstdint>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    using namespace VK::Inside;
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    parsePosixRule(bytes);
    const auto zone = parseZoneFile(bytes);
    if (!zone) return 0;
    for (const std::int64_t instant :
         {INT64_MIN, std::int64_t{-1}, std::int64_t{0}, std::int64_t{1784073600}, INT64_MAX}) {
        const std::int32_t offset = zone->at(instant).offset;
        if (offset < -26 * 3600 || offset > 26 * 3600) std::abort();
        zone->standardOffsetAt(instant);
        zone->hasDaylightSavingFrom(instant);
    }
    return 0;
}
