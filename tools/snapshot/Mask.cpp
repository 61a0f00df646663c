#include "tools/snapshot/Mask.h"

#include "common/Text.h"
#include "host/Placeholder.h"
#include "host/Uuid.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <sha2.h>
#include <vector>

namespace snapshot {

using VK::Host::placeholderRule;

namespace {

const VK::Host::PlaceholderRule* ruleOf(std::string_view text) {
    return placeholderRule(VK::cleanText(text), VK::Host::FirmwareText::Other);
}

bool beginsAsFiller(std::string_view text) {
    const VK::Host::PlaceholderRule* const rule = ruleOf(text);
    return rule != nullptr && rule->match == VK::Host::PlaceholderRule::Begin;
}

/// A filler without what may stand behind "to be filled by" and the like, which still is one.
std::string onlyFiller(std::string text) {
    if (!beginsAsFiller(text)) return text;
    std::size_t length = 0;
    while (!beginsAsFiller(std::string_view(text).substr(0, length))) ++length;
    return text.replace(length, std::string::npos, text.size() - length, '.');
}

char other(char character, unsigned char byte) {
    const auto inRange = [&](char first, int count) { return static_cast<char>(first + byte % count); };
    if (character >= '0' && character <= '9') return inRange('0', 10);
    if (character >= 'a' && character <= 'z') return inRange('a', 26);
    if (character >= 'A' && character <= 'Z') return inRange('A', 26);
    return static_cast<unsigned char>(character) < 0x80 ? character : inRange('0', 10);
}

bool isHexDigit(char c) {
    return std::string_view("0123456789abcdefABCDEF").find(c) != std::string_view::npos;
}

/// The 32 digits of what is a UUID in any of its shapes, in lower case; empty for other texts.
std::string digitsOf(const std::string& text) {
    constexpr std::string_view between = "{}- \t\r\n\v\f";
    std::string digits;
    for (const char c : VK::lowerCase(text)) {
        if (isHexDigit(c))
            digits += c;
        else if (between.find(c) == std::string_view::npos)
            return {};
    }
    return digits.size() == 32 ? digits : std::string();
}

} // namespace

std::string bytesOfDigits(std::string_view digits) {
    std::string bytes;
    for (std::size_t i = 0; i + 1 < digits.size(); i += digits[i] == '-' ? 1 : 2)
        if (digits[i] != '-') bytes += static_cast<char>(std::stoul(std::string(digits.substr(i, 2)), nullptr, 16));
    return bytes;
}

std::string Mask::stream(std::string_view text, std::size_t count, unsigned int turn) const {
    std::string made;
    while (made.size() < count) {
        std::string hashed = salt;
        hashed += static_cast<char>(turn);
        hashed += static_cast<char>(made.size() & 0xFF);
        hashed += text;
        std::array<std::uint8_t, SHA256_DIGEST_LENGTH> digest{};
        SHA2_CTX context;
        SHA256Init(&context);
        SHA256Update(&context, reinterpret_cast<const std::uint8_t*>(hashed.data()), hashed.size());
        SHA256Final(digest.data(), &context);
        made.append(digest.begin(), digest.end());
    }
    return made.substr(0, count);
}

std::string Mask::name(const std::string& text) const {
    constexpr unsigned int turns = 100; // a short text may be a filler or itself again
    if (ruleOf(text) != nullptr) return onlyFiller(text);
    std::string masked = text;
    for (unsigned int turn = 0; turn < turns && (masked == text || ruleOf(masked) != nullptr); ++turn) {
        const std::string_view bare = VK::trimmed(text);
        const std::string bytes = stream(bare, bare.size(), turn);
        const auto begin = masked.begin() + (bare.data() - text.data());
        std::transform(bare.begin(), bare.end(), bytes.begin(), begin,
                       [](char c, char byte) { return other(c, static_cast<unsigned char>(byte)); });
    }
    return masked;
}

std::string Mask::serial(const std::string& text) {
    constexpr std::size_t shortest = 4; // a shorter one may stand anywhere by chance
    std::string masked = name(text);
    const std::string_view bare = VK::trimmed(text);
    if (masked != text && bare.size() >= shortest) replaced[std::string(bare)] = VK::trimmed(masked);
    return masked;
}

std::string Mask::uuid(const std::string& text) const {
    const std::string digits = digitsOf(text);
    if (digits.empty()) return name(text);
    if (VK::Host::isSharedUuid(digits)) return text;
    const std::string bytes = stream(bytesOfDigits(digits), digits.size() / 2, 0);

    const bool isUpper = std::none_of(text.begin(), text.end(), [](char c) { return c >= 'a' && c <= 'z'; });
    const char* const hex = isUpper ? "0123456789ABCDEF" : "0123456789abcdef";
    std::string masked = text;
    unsigned int place = 0;
    for (char& c : masked) {
        if (!isHexDigit(c)) continue;
        const auto byte = static_cast<unsigned char>(bytes[place / 2]);
        c = hex[place++ % 2 == 0 ? byte >> 4 : byte & 15];
    }
    return masked;
}

std::string Mask::everywhere(std::string bytes) const {
    std::vector<std::pair<std::string, std::string>> longestFirst(replaced.begin(), replaced.end());
    std::stable_sort(longestFirst.begin(), longestFirst.end(),
                     [](const auto& a, const auto& b) { return a.first.size() > b.first.size(); });
    for (const auto& [number, masked] : longestFirst)
        for (std::size_t at = bytes.find(number); at != std::string::npos; at = bytes.find(number, at + masked.size()))
            bytes.replace(at, number.size(), masked);
    return bytes;
}

} // namespace snapshot
