#pragma once

#include <array>
#include <cstddef>
#include <string>
#include <string_view>

namespace fuzz {

/// A fuzzer's bytes as decisions: one byte each, and 0 when they have run out, so that seeds can be made by hand.
class Choices {
public:
    Choices(const unsigned char* bytes, std::size_t count) : data(bytes), left(count) {}

    /// A number below `count`.
    std::size_t below(std::size_t count) { return byte() % count; }
    bool oneIn(std::size_t count) { return below(count) == count - 1; }

    template <std::size_t Size>
    std::string one(const std::array<const char*, Size>& of) {
        return of[below(Size)];
    }

    /// One of these, or a text of up to 15 bytes of any kind.
    template <class Known>
    std::string text(const Known& known) {
        const std::size_t choice = below(known.size() + 1);
        if (choice < known.size()) return known[choice];
        std::string made(below(16), '\0');
        for (char& character : made) character = static_cast<char>(byte());
        return made;
    }

    std::string_view rest() const { return {reinterpret_cast<const char*>(data), left}; }

private:
    unsigned char byte() {
        if (left == 0) return 0;
        --left;
        return *data++;
    }

    const unsigned char* data;
    std::size_t left;
};

} // namespace fuzz
