#include "product/HmacSha256.h"

#include <algorithm>
#include <initializer_list>
#include <sha2.h>

namespace VK {

namespace {

using Block = std::array<std::uint8_t, SHA256_BLOCK_LENGTH>;

std::string_view bytesOf(const std::uint8_t* bytes, std::size_t size) {
    return {reinterpret_cast<const char*>(bytes), size};
}

/// The SHA-256 of the parts, one behind the other.
Sha256Digest sha256(std::initializer_list<std::string_view> parts) {
    SHA2_CTX context;
    SHA256Init(&context);
    for (const std::string_view part : parts)
        SHA256Update(&context, reinterpret_cast<const std::uint8_t*>(part.data()), part.size());
    Sha256Digest digest{};
    SHA256Final(digest.data(), &context);
    return digest;
}

/// The key as one block: a longer one is hashed first.
Block blockOf(std::string_view key) {
    Block block{};
    if (key.size() <= block.size()) {
        std::copy(key.begin(), key.end(), block.begin());
    } else {
        const Sha256Digest digest = sha256({key});
        std::copy(digest.begin(), digest.end(), block.begin());
    }
    return block;
}

Sha256Digest keyed(Block key, std::uint8_t pad, std::string_view rest) {
    for (std::uint8_t& byte : key) byte ^= pad;
    return sha256({bytesOf(key.data(), key.size()), rest});
}

} // namespace

Sha256Digest hmacSha256(std::string_view key, std::string_view message) {
    const Block block = blockOf(key);
    const Sha256Digest inner = keyed(block, 0x36, message);
    return keyed(block, 0x5c, bytesOf(inner.data(), inner.size()));
}

} // namespace VK
