#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace VK {

using Sha256Digest = std::array<std::uint8_t, 32>;

/// SHA-256 as FIPS 180-4 has it, over bytes that come in pieces.
class Sha256 {
public:
    void update(std::string_view bytes);
    /// Ends the message; the object is used up.
    Sha256Digest finish();

private:
    void update(std::uint8_t byte);
    void compress();

    std::array<std::uint32_t, 8> state{0x6a09e667, 0xbb67ae85, 0x3c6ef372, 0xa54ff53a,
                                       0x510e527f, 0x9b05688c, 0x1f83d9ab, 0x5be0cd19};
    std::array<std::uint8_t, 64> block{};
    std::uint64_t length = 0; ///< in bytes
};

/// HMAC-SHA256 as RFC 2104 has it.
Sha256Digest hmacSha256(std::string_view key, std::string_view message);

} // namespace VK
