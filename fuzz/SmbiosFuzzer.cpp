#include "instrumentation/Smbios.h"

#include <algorithm>
#include <cstdlib>

/// The first byte is the length of the entry point that follows it; the rest is the table. A second run repairs the
/// entry point, so that the table's parser is reached whatever the bytes are.
extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    using VK::Inside::parseSmbios;
    if (size == 0) return 0;
    const std::string_view bytes(reinterpret_cast<const char*>(data) + 1, size - 1);
    const std::size_t length = std::min<std::size_t>(data[0], bytes.size());
    const std::string_view table = bytes.substr(length);
    parseSmbios(bytes.substr(0, length), table);

    std::string entryPoint("_SM3_\0\x18\3\2\0\1\0\xFF\xFF\x0F\0\0\0\0\0\0\0\0\0", 24);
    unsigned int sum = 0;
    for (const char c : entryPoint) sum += static_cast<unsigned char>(c);
    entryPoint[5] = static_cast<char>(0x100 - (sum & 0xFF));
    const VK::Inside::Smbios smbios = parseSmbios(entryPoint, table);
    if (!smbios.entryPointProblem.empty()) std::abort(); // it is right
    for (const VK::Inside::SmbiosChassis& chassis : smbios.chassis)
        if (chassis.serial.size() > 256 || chassis.type > 127) std::abort();
    return 0;
}
