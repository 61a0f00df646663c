#include "support/SmbiosImage.h"

namespace support {

using namespace std::literals;

namespace {

void put(std::string& bytes, std::size_t offset, std::size_t value, std::size_t length) {
    for (std::size_t i = 0; i < length; ++i) bytes[offset + i] = static_cast<char>(value >> (8 * i) & 0xFF);
}

/// Sets the byte that makes a range sum up to zero.
void putChecksum(std::string& bytes, std::size_t begin, std::size_t length, std::size_t offset) {
    bytes[offset] = '\0';
    unsigned int sum = 0;
    for (std::size_t i = 0; i < length; ++i) sum += static_cast<unsigned char>(bytes[begin + i]);
    bytes[offset] = static_cast<char>(0x100 - (sum & 0xFF));
}

} // namespace

SmbiosStructureImage::SmbiosStructureImage(unsigned char type, std::size_t length) : formatted(length, '\0') {
    byte(0, type);
    byte(1, static_cast<unsigned int>(length));
}

SmbiosStructureImage& SmbiosStructureImage::byte(std::size_t offset, unsigned int value) {
    formatted.at(offset) = static_cast<char>(value);
    return *this;
}

SmbiosStructureImage& SmbiosStructureImage::bytes(std::size_t offset, const std::string& values) {
    formatted.replace(offset, values.size(), values);
    return *this;
}

SmbiosStructureImage& SmbiosStructureImage::text(std::size_t offset, const std::string& value) {
    if (value.empty()) return *this;
    strings.push_back(value);
    return byte(offset, static_cast<unsigned int>(strings.size()));
}

std::string SmbiosStructureImage::image(unsigned int handle) const {
    std::string result = formatted;
    put(result, 2, handle, 2);
    for (const std::string& each : strings) result += each + '\0';
    return result + (strings.empty() ? "\0\0"s : "\0"s);
}

SmbiosStructureImage SmbiosSystemImage::structure() const {
    SmbiosStructureImage image(1, 0x1B);
    image.text(0x04, manufacturer).text(0x05, product).text(0x06, version).text(0x07, serial).text(0x19, sku);
    return image.bytes(0x08, uuid);
}

SmbiosStructureImage SmbiosChassisImage::structure() const {
    SmbiosStructureImage image(3, 0x19);
    image.text(0x04, manufacturer).text(0x06, version).text(0x07, serial).text(0x18, sku);
    image.byte(0x09, bootUpState).byte(0x0A, powerSupplyState).byte(0x0B, thermalState);
    return image.byte(0x05, type).byte(0x13, 1).byte(0x14, 3).bytes(0x15, "\x8A\x01\x04");
}

SmbiosImage& SmbiosImage::add(const SmbiosStructureImage& structure) {
    bytes += structure.image(0x100 + structures++);
    return *this;
}

SmbiosImage& SmbiosImage::addRaw(const std::string& raw) {
    bytes += raw;
    return *this;
}

std::string SmbiosImage::entryPoint() const {
    if (kind == Version3) {
        std::string result = "_SM3_"s + std::string(19, '\0');
        put(result, 6, result.size(), 1);
        put(result, 7, major, 1);
        put(result, 8, minor, 1);
        put(result, 10, 1, 1);
        put(result, 12, bytes.size(), 4);
        putChecksum(result, 0, result.size(), 5);
        return result;
    }
    std::string inner = "_DMI_"s + std::string(10, '\0');
    put(inner, 6, bytes.size(), 2);
    put(inner, 12, structures, 2);
    put(inner, 14, major << 4 | (minor & 15), 1);
    putChecksum(inner, 0, inner.size(), 5);
    if (kind == Legacy) return inner;
    std::string outer = "_SM_"s + std::string(12, '\0') + inner;
    put(outer, 5, outer.size(), 1);
    put(outer, 6, major, 1);
    put(outer, 7, minor, 1);
    putChecksum(outer, 0, outer.size(), 4);
    return outer;
}

void SmbiosImage::writeTo(const TemporaryDirectory& directory) const {
    directory.write("sys/firmware/dmi/tables/smbios_entry_point", entryPoint());
    directory.write("sys/firmware/dmi/tables/DMI", bytes);
}

} // namespace support
