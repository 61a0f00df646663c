#pragma once

#include <cstddef>
#include <cstring>
#include <initializer_list>
#include <string_view>

namespace VK {

/// A number as a signed decimal, as these lines have always shown numbers: 4294967295 prints as -1.
class SignedDecimal {
public:
    explicit SignedDecimal(unsigned int number) : first(digits + sizeof digits) {
        const bool negative = static_cast<int>(number) < 0;
        unsigned int rest = negative ? 0U - number : number;
        do {
            *--first = static_cast<char>('0' + rest % 10);
            rest /= 10;
        } while (rest != 0);
        if (negative) *--first = '-';
    }
    SignedDecimal(const SignedDecimal&) = delete;
    SignedDecimal& operator=(const SignedDecimal&) = delete;

    operator std::string_view() const { return {first, static_cast<std::size_t>(digits + sizeof digits - first)}; }

private:
    char digits[11]; ///< of -2147483648
    char* first;
};

/// Room for a text of `bytes` with its final zero; what goes beyond is cut. Trivial, so that it can be thread-local in
/// a library that gets unloaded.
template <std::size_t bytes>
struct TextBuffer {
    static constexpr std::size_t size = bytes;

    char text[size];
    std::size_t length;

    /// Appends pieces: texts, views and numbers. Inline, so that a literal is appended with its length known: a few
    /// moves instead of two calls.
    template <class... Pieces>
    __attribute__((always_inline)) TextBuffer& add(const Pieces&... pieces) {
        return append(view(pieces)...);
    }

    TextBuffer& start() {
        length = 0;
        return *this;
    }

    std::string_view line() const { return {text, length}; }

    /// Clears what is left behind the line, so that all bytes not written are zero.
    char* finish() {
        std::memset(text + length, 0, size - length);
        return text;
    }

private:
    /// Null prints as printf prints it.
    static std::string_view view(const char* piece) { return piece != nullptr ? piece : "(null)"; }
    static std::string_view view(std::string_view piece) { return piece; }

    template <class... Views>
    __attribute__((always_inline)) TextBuffer& append(Views... views) {
        if (__builtin_expect((views.size() + ...) < size - length, true)) { // GCOVR_EXCL_BR_LINE: counted for each call
            (copy(views), ...);
            return *this;
        }
        return cut({views...});
    }

    __attribute__((always_inline)) void copy(std::string_view piece) {
        std::memcpy(text + length, piece.data(), piece.size());
        length += piece.size();
    }

    __attribute__((noinline, cold)) TextBuffer& cut(std::initializer_list<std::string_view> views) {
        for (const std::string_view piece : views) copy(piece.substr(0, size - 1 - length));
        return *this;
    }
};

/// Room for one formatted line: 511 characters.
using MessageBuffer = TextBuffer<512>;

} // namespace VK
