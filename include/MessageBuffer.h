#pragma once

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <cstring>

namespace VK {

/// Room for one formatted line: 511 characters, what goes beyond is cut. Trivial, so that it can be thread-local in a
/// library that gets unloaded.
struct MessageBuffer {
    static constexpr std::size_t size = 512;

    char text[size];
    std::size_t length;

    MessageBuffer& start() {
        length = 0;
        return *this;
    }

    /// Appends a text; null prints as printf prints it.
    MessageBuffer& add(const char* part) {
        if (part == nullptr) part = "(null)";
        return add(part, std::strlen(part));
    }

    MessageBuffer& add(const char* part, std::size_t partLength) {
        partLength = std::min(partLength, size - 1 - length);
        std::memcpy(text + length, part, partLength);
        length += partLength;
        return *this;
    }

    /// Appends a number as a signed decimal, as these lines have always shown numbers: 4294967295 prints as -1.
    MessageBuffer& addSigned(unsigned int number) {
        char digits[12];
        const auto end = std::to_chars(digits, digits + sizeof digits, static_cast<int>(number)).ptr;
        return add(digits, static_cast<std::size_t>(end - digits));
    }

    /// Clears what is left behind the line, so that all bytes not written are zero.
    char* finish() {
        std::memset(text + length, 0, size - length);
        return text;
    }
};

} // namespace VK
