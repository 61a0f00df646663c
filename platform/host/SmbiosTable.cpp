#include "host/SmbiosTable.h"

#include <algorithm>

namespace VK::Host {

using namespace std::literals;

namespace {

constexpr unsigned int endOfTable = 127;
constexpr std::size_t shortestStructure = 4;

unsigned int byteOf(std::string_view bytes, std::size_t offset) {
    return static_cast<unsigned char>(bytes[offset]);
}

std::size_t littleEndian(std::string_view bytes, std::size_t offset, std::size_t length) {
    std::size_t value = 0;
    while (length-- > 0) value = value << 8 | byteOf(bytes, offset + length);
    return value;
}

bool sumsUpToZero(std::string_view bytes) {
    unsigned int sum = 0;
    for (const char c : bytes) sum += static_cast<unsigned char>(c);
    return (sum & 0xFF) == 0;
}

/// Versions that some firmware misprints, and what it means.
SmbiosVersion mended(unsigned int major, unsigned int minor) {
    if (major == 2 && (minor == 31 || minor == 33)) return {2, 3};
    if (major == 2 && minor == 51) return {2, 6};
    return {major, minor};
}

SmbiosEntryPoint unusable(const char* problem) {
    SmbiosEntryPoint result;
    result.problem = problem;
    return result;
}

SmbiosEntryPoint parseEntryPoint3(std::string_view bytes) {
    constexpr std::size_t shortest = 24;
    if (bytes.size() < shortest) return unusable("entry point too short");
    const std::size_t length = byteOf(bytes, 6);
    if (length < shortest || length > bytes.size()) return unusable("entry point states a wrong length");
    if (!sumsUpToZero(bytes.substr(0, length))) return unusable("entry point's checksum is wrong");
    return {mended(byteOf(bytes, 7), byteOf(bytes, 8)), littleEndian(bytes, 12, 4), {}};
}

SmbiosEntryPoint parseLegacyEntryPoint(std::string_view bytes) {
    constexpr std::size_t checkedLength = 15;
    if (bytes.size() < checkedLength) return unusable("entry point too short");
    if (!sumsUpToZero(bytes.substr(0, checkedLength))) return unusable("entry point's checksum is wrong");
    const unsigned int version = byteOf(bytes, 14); // a digit in each half
    return {mended(version >> 4, version & 15), littleEndian(bytes, 6, 2), {}};
}

SmbiosEntryPoint parseEntryPoint2(std::string_view bytes) {
    constexpr std::size_t shortest = 30; // some firmware counts 30, and so do kernels that show it
    if (bytes.size() < shortest) return unusable("entry point too short");
    const std::size_t length = byteOf(bytes, 5);
    if (length < shortest || length > bytes.size()) return unusable("entry point states a wrong length");
    if (!sumsUpToZero(bytes.substr(0, length))) return unusable("entry point's checksum is wrong");
    const std::string_view inner = bytes.substr(16);
    if (inner.substr(0, 5) != "_DMI_"sv) return unusable("entry point without its inner part");
    // A 31st byte that was cut off belongs to no sum of ours.
    if (inner.size() >= 15 && !sumsUpToZero(inner.substr(0, 15))) return unusable("entry point's checksum is wrong");
    return {mended(byteOf(bytes, 6), byteOf(bytes, 7)), littleEndian(inner, 6, 2), {}};
}

} // namespace

SmbiosEntryPoint parseSmbiosEntryPoint(std::string_view bytes) {
    if (bytes.substr(0, 5) == "_SM3_"sv) return parseEntryPoint3(bytes);
    if (bytes.substr(0, 4) == "_SM_"sv) return parseEntryPoint2(bytes);
    if (bytes.substr(0, 5) == "_DMI_"sv) return parseLegacyEntryPoint(bytes);
    return unusable("no entry point");
}

std::optional<unsigned int> SmbiosStructure::byteAt(std::size_t offset) const {
    if (offset >= formatted.size()) return std::nullopt;
    return byteOf(formatted, offset);
}

std::optional<std::string_view> SmbiosStructure::bytesAt(std::size_t offset, std::size_t length) const {
    if (offset > formatted.size() || length > formatted.size() - offset) return std::nullopt;
    return formatted.substr(offset, length);
}

std::string_view SmbiosStructure::stringAt(std::size_t offset, std::size_t& badIndexes) const {
    unsigned int index = byteAt(offset).value_or(0);
    if (index == 0) return {};
    for (std::string_view left = strings; !left.empty();) {
        const std::size_t length = left.find('\0');
        if (--index == 0) return left.substr(0, length);
        left.remove_prefix(std::min(left.size(), length + 1));
    }
    ++badIndexes;
    return {};
}

std::nullopt_t SmbiosTable::stop(const char* problem) {
    broken = std::string(problem) + " at byte " + std::to_string(size - rest.size());
    rest = {};
    return std::nullopt;
}

std::optional<SmbiosStructure> SmbiosTable::next() {
    if (rest.find_first_not_of('\0') == std::string_view::npos) return std::nullopt;
    if (rest.size() < shortestStructure) return stop("structure cut off");
    const unsigned int type = byteOf(rest, 0);
    const std::size_t length = byteOf(rest, 1);
    if (type == endOfTable) {
        rest = {};
        return std::nullopt;
    }
    if (length < shortestStructure) return stop("structure shorter than 4 bytes");
    if (length > rest.size()) return stop("structure cut off");
    const std::size_t end = rest.find("\0\0"sv, length);
    if (end == std::string_view::npos) return stop("structure whose strings do not end");
    // Without strings the two NULs follow at once, else the first of them ends the last string.
    const std::string_view strings = end == length ? std::string_view() : rest.substr(length, end + 1 - length);
    const SmbiosStructure result(rest.substr(0, length), strings);
    rest.remove_prefix(end + 2);
    return result;
}

} // namespace VK::Host
