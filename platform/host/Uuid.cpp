#include "host/Uuid.h"

#include "common/Text.h"

#include <algorithm>
#include <array>

namespace VK::Host {

namespace {

/// Unset ones, and those that whole product lines share.
constexpr std::string_view JUNK[] = {"00000000-0000-0000-0000-000000000000", "ffffffff-ffff-ffff-ffff-ffffffffffff",
                                     "03000200-0400-0500-0006-000700080009", "03020100-0504-0706-0809-0a0b0c0d0e0f",
                                     "10000000-0000-8000-0040-000000000000", "fefefefe-fefe-fefe-fefe-fefefefefefe"};

constexpr std::size_t TEXT_LENGTH = 36;

bool isDashPlace(std::size_t place) {
    return place == 8 || place == 13 || place == 18 || place == 23;
}

std::string unlessJunk(std::string uuid) {
    return std::find(std::begin(JUNK), std::end(JUNK), uuid) == std::end(JUNK) ? uuid : std::string();
}

} // namespace

std::string uuidFromBytes(std::string_view bytes, SmbiosVersion version) {
    static constexpr std::array<std::size_t, 16> LITTLE_ENDIAN_FIELDS{3, 2, 1,  0,  5,  4,  7,  6,
                                                                      8, 9, 10, 11, 12, 13, 14, 15};
    static constexpr char DIGITS[] = "0123456789abcdef";
    if (bytes.size() != 16) return {};
    const bool swapped = version.isAtLeast(2, 6);
    std::string text;
    for (std::size_t i = 0; i < 16; ++i) {
        if (isDashPlace(text.size())) text += '-';
        const auto byte = static_cast<unsigned char>(bytes[swapped ? LITTLE_ENDIAN_FIELDS[i] : i]);
        text += DIGITS[byte >> 4];
        text += DIGITS[byte & 15];
    }
    return text;
}

std::string uuidFromText(std::string_view text) {
    std::string uuid = lowerCase(trimmed(text));
    if (uuid.size() != TEXT_LENGTH) return {};
    for (std::size_t i = 0; i < TEXT_LENGTH; ++i) {
        const bool digit = (uuid[i] >= '0' && uuid[i] <= '9') || (uuid[i] >= 'a' && uuid[i] <= 'f');
        if (isDashPlace(i) ? uuid[i] != '-' : !digit) return {};
    }
    return unlessJunk(std::move(uuid));
}

} // namespace VK::Host
