#include "product/Sha256.h"

#include <algorithm>
#include <string>

namespace VK {

namespace {

constexpr std::array<std::uint32_t, 64> ROUND_CONSTANTS{
    0x428a2f98, 0x71374491, 0xb5c0fbcf, 0xe9b5dba5, 0x3956c25b, 0x59f111f1, 0x923f82a4, 0xab1c5ed5,
    0xd807aa98, 0x12835b01, 0x243185be, 0x550c7dc3, 0x72be5d74, 0x80deb1fe, 0x9bdc06a7, 0xc19bf174,
    0xe49b69c1, 0xefbe4786, 0x0fc19dc6, 0x240ca1cc, 0x2de92c6f, 0x4a7484aa, 0x5cb0a9dc, 0x76f988da,
    0x983e5152, 0xa831c66d, 0xb00327c8, 0xbf597fc7, 0xc6e00bf3, 0xd5a79147, 0x06ca6351, 0x14292967,
    0x27b70a85, 0x2e1b2138, 0x4d2c6dfc, 0x53380d13, 0x650a7354, 0x766a0abb, 0x81c2c92e, 0x92722c85,
    0xa2bfe8a1, 0xa81a664b, 0xc24b8b70, 0xc76c51a3, 0xd192e819, 0xd6990624, 0xf40e3585, 0x106aa070,
    0x19a4c116, 0x1e376c08, 0x2748774c, 0x34b0bcb5, 0x391c0cb3, 0x4ed8aa4a, 0x5b9cca4f, 0x682e6ff3,
    0x748f82ee, 0x78a5636f, 0x84c87814, 0x8cc70208, 0x90befffa, 0xa4506ceb, 0xbef9a3f7, 0xc67178f2};

constexpr std::uint32_t rotate(std::uint32_t x, int n) {
    return x >> n | x << (32 - n);
}

std::array<std::uint32_t, 64> schedule(const std::array<std::uint8_t, 64>& block) {
    std::array<std::uint32_t, 64> w{};
    for (std::size_t i = 0; i < 16; ++i)
        w[i] = std::uint32_t{block[4 * i]} << 24 | std::uint32_t{block[4 * i + 1]} << 16 |
               std::uint32_t{block[4 * i + 2]} << 8 | block[4 * i + 3];
    for (std::size_t i = 16; i < 64; ++i) {
        const std::uint32_t s0 = rotate(w[i - 15], 7) ^ rotate(w[i - 15], 18) ^ w[i - 15] >> 3;
        const std::uint32_t s1 = rotate(w[i - 2], 17) ^ rotate(w[i - 2], 19) ^ w[i - 2] >> 10;
        w[i] = w[i - 16] + s0 + w[i - 7] + s1;
    }
    return w;
}

} // namespace

void Sha256::compress() {
    const auto w = schedule(block);
    auto [a, b, c, d, e, f, g, h] = state;
    for (std::size_t i = 0; i < 64; ++i) {
        const std::uint32_t s1 = rotate(e, 6) ^ rotate(e, 11) ^ rotate(e, 25);
        const std::uint32_t t1 = h + s1 + ((e & f) ^ (~e & g)) + ROUND_CONSTANTS[i] + w[i];
        const std::uint32_t s0 = rotate(a, 2) ^ rotate(a, 13) ^ rotate(a, 22);
        const std::uint32_t t2 = s0 + ((a & b) ^ (a & c) ^ (b & c));
        h = g;
        g = f;
        f = e;
        e = d + t1;
        d = c;
        c = b;
        b = a;
        a = t1 + t2;
    }
    const std::array<std::uint32_t, 8> sum{a, b, c, d, e, f, g, h};
    for (std::size_t i = 0; i < 8; ++i) state[i] += sum[i];
}

void Sha256::update(std::uint8_t byte) {
    block[length++ % block.size()] = byte;
    if (length % block.size() == 0) compress();
}

void Sha256::update(std::string_view bytes) {
    for (const char byte : bytes) update(static_cast<std::uint8_t>(byte));
}

Sha256Digest Sha256::finish() {
    const std::uint64_t bits = length * 8;
    update(std::uint8_t{0x80});
    while (length % block.size() != block.size() - sizeof bits) update(std::uint8_t{0});
    for (int shift = 56; shift >= 0; shift -= 8) update(static_cast<std::uint8_t>(bits >> shift));

    Sha256Digest digest{};
    for (std::size_t i = 0; i < digest.size(); ++i)
        digest[i] = static_cast<std::uint8_t>(state[i / 4] >> (24 - 8 * (i % 4)));
    return digest;
}

Sha256Digest hmacSha256(std::string_view key, std::string_view message) {
    constexpr std::size_t BLOCK = 64;
    const auto text = [](const Sha256Digest& digest) { return std::string(digest.begin(), digest.end()); };
    std::string padded(key);
    if (padded.size() > BLOCK) {
        Sha256 hash;
        hash.update(key);
        padded = text(hash.finish());
    }
    padded.resize(BLOCK);
    const auto hashed = [&padded](char pad, std::string_view rest) {
        std::string start = padded;
        for (char& c : start) c = static_cast<char>(c ^ pad);
        Sha256 hash;
        hash.update(start);
        hash.update(rest);
        return hash.finish();
    };
    return hashed(0x5c, text(hashed(0x36, message)));
}

} // namespace VK
