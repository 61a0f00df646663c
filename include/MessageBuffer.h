#pragma once

#include <charconv>
#include <cstddef>
#include <cstring>
#include <string_view>

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
    MessageBuffer& add(const char* part) { return add(textOrNull(part)); }

    /// Inline, so that a literal is appended with its length known: a few moves instead of two calls.
    MessageBuffer& add(std::string_view part) {
        if (__builtin_expect(part.size() > room(), false)) return cut(part);
        std::memcpy(text + length, part.data(), part.size());
        length += part.size();
        return *this;
    }

    /// Appends a number as a signed decimal, as these lines have always shown numbers: 4294967295 prints as -1.
    MessageBuffer& addSigned(unsigned int number) {
        constexpr std::size_t longest = 11; // -2147483648
        char digits[longest];
        char* const place = room() < longest ? digits : text + length;
        const auto end = std::to_chars(place, place + longest, static_cast<int>(number)).ptr;
        const auto written = static_cast<std::size_t>(end - place);
        if (place == digits) return add({digits, written});
        length += written;
        return *this;
    }

    /// Clears what is left behind the line, so that all bytes not written are zero.
    char* finish() {
        std::memset(text + length, 0, size - length);
        return text;
    }

    /// A text as it is printed.
    static std::string_view textOrNull(const char* part) { return part != nullptr ? part : "(null)"; }

private:
    std::size_t room() const { return size - 1 - length; }

    __attribute__((noinline, cold)) MessageBuffer& cut(std::string_view part) { return add(part.substr(0, room())); }
};

} // namespace VK
