#include "host/Uuid.h"

#include "common/Text.h"
#include "host/Placeholder.h"

#include <algorithm>
#include <array>

namespace VK::Host {

namespace {

constexpr std::string_view shared[] = {
#define SHARED_UUID(MACHINES, REASON, BYTES) BYTES,
#include "host/Placeholders.inc"
};

constexpr std::size_t textLength = 36;

/// Where the first three fields' bytes stand when they are stored little-endian.
constexpr std::array<std::size_t, 16> littleEndianFields{3, 2, 1, 0, 5, 4, 7, 6, 8, 9, 10, 11, 12, 13, 14, 15};

bool isDashPlace(std::size_t place) {
    return place == 8 || place == 13 || place == 18 || place == 23;
}

std::string digitsOf(std::string_view uuid) {
    std::string digits(uuid);
    digits.erase(std::remove(digits.begin(), digits.end(), '-'), digits.end());
    return digits;
}

std::string inOtherOrder(std::string_view digits) {
    std::string result;
    for (const std::size_t byte : littleEndianFields) result += digits.substr(2 * byte, 2);
    return result;
}

/// Whether the characters where the pattern has tt, seven bits each, make up a service tag that says nothing.
bool hasNoServiceTag(std::string_view digits, std::string_view pattern) {
    std::string tag;
    for (std::size_t i = 0; i < pattern.size(); i += 2)
        if (pattern[i] == 't')
            tag += static_cast<char>(std::stoul(std::string(digits.substr(i, 2)), nullptr, 16) & 0x7F);
    return isPlaceholder(cleanText(tag));
}

/// A pattern is the digits; or digits with tt for the characters of a service tag; or the first digits and a star, for
/// all that end neither in the address of a network card nor in anything else of one machine's own.
bool isLike(std::string_view digits, std::string_view pattern) {
    constexpr std::size_t node = 20;
    if (pattern.back() == '*')
        return digits.find_first_not_of(digits[node], node) == std::string_view::npos &&
               digits.substr(0, pattern.size() - 1) == pattern.substr(0, pattern.size() - 1);
    return std::equal(digits.begin(), digits.end(), pattern.begin(), pattern.end(),
                      [](char digit, char like) { return like == 't' || digit == like; }) &&
           (pattern.find('t') == std::string_view::npos || hasNoServiceTag(digits, pattern));
}

} // namespace

// A text does not say how its bytes are stored, and the version of the tables often states it wrongly: both orders
// count.
bool isSharedUuid(std::string_view uuid) {
    const std::string digits = digitsOf(uuid);
    const std::string other = inOtherOrder(digits);
    return std::any_of(std::begin(shared), std::end(shared),
                       [&](std::string_view pattern) { return isLike(digits, pattern) || isLike(other, pattern); });
}

std::string uuidFromBytes(std::string_view bytes, SmbiosVersion version) {
    static constexpr char hexDigits[] = "0123456789abcdef";
    if (bytes.size() != 16) return {};
    const bool swapped = version.isAtLeast(2, 6);
    std::string text;
    for (std::size_t i = 0; i < 16; ++i) {
        if (isDashPlace(text.size())) text += '-';
        const auto byte = static_cast<unsigned char>(bytes[swapped ? littleEndianFields[i] : i]);
        text += hexDigits[byte >> 4];
        text += hexDigits[byte & 15];
    }
    return text;
}

std::string uuidFromText(std::string_view text) {
    std::string uuid = lowerCase(trimmed(text));
    if (uuid.size() != textLength) return {};
    for (std::size_t i = 0; i < textLength; ++i) {
        const bool digit = (uuid[i] >= '0' && uuid[i] <= '9') || (uuid[i] >= 'a' && uuid[i] <= 'f');
        if (isDashPlace(i) ? uuid[i] != '-' : !digit) return {};
    }
    return isSharedUuid(uuid) ? std::string() : uuid;
}

} // namespace VK::Host
