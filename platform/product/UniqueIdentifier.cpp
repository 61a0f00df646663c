#include "product/UniqueIdentifier.h"

#include "product/HmacSha256.h"

namespace VK {

namespace {

// Published identifiers hang on it: it never changes.
constexpr const char* key = "vk.platform.product.unique-identifier.1";

} // namespace

std::string uniqueIdentifier(const std::string& secret) {
    if (secret.empty()) return {};
    constexpr std::size_t uuidBytes = 16;
    constexpr const char* hex = "0123456789abcdef";
    Sha256Digest digest = hmacSha256(key, secret);
    digest[6] = static_cast<std::uint8_t>((digest[6] & 0x0F) | 0x80); // version 8
    digest[8] = static_cast<std::uint8_t>((digest[8] & 0x3F) | 0x80); // variant of RFC 9562
    std::string text;
    for (std::size_t i = 0; i < uuidBytes; ++i) {
        if (i == 4 || i == 6 || i == 8 || i == 10) text += '-';
        text += hex[digest[i] >> 4];
        text += hex[digest[i] & 0xF];
    }
    return text;
}

} // namespace VK
