#pragma once

#include <array>
#include <cstdint>
#include <string_view>

namespace VK {

using Sha256Digest = std::array<std::uint8_t, 32>;

/// HMAC-SHA256 as RFC 2104 has it.
Sha256Digest hmacSha256(std::string_view key, std::string_view message);

} // namespace VK
