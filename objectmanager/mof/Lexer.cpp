#include "objectmanager/mof/Lexer.h"

#include "objectmanager/model/Characters.h"
#include "objectmanager/model/Names.h"
#include "objectmanager/mof/MofError.h"

#include <utf8.h>

#include <algorithm>

namespace mof {
namespace {

using Kind = Token::Kind;

constexpr bool isHexDigit(char c) {
    return om::isDigit(c) || (om::lower(c) >= 'a' && om::lower(c) <= 'f');
}

constexpr bool isSign(char c) {
    return c == '+' || c == '-';
}

constexpr bool isLetter(char c) {
    return om::lower(c) >= 'a' && om::lower(c) <= 'z';
}

constexpr bool isInName(char c) {
    return isLetter(c) || om::isDigit(c) || c == '_';
}

constexpr std::string_view blanks = " \t\r\n";
constexpr std::string_view marks = "[]{}():;,=";
// What stands for what behind a backslash.
constexpr std::string_view escapes = "btnfr\"'\\";
constexpr std::string_view escaped = "\b\t\n\f\r\"'\\";

class Lexer {
public:
    Lexer(std::string_view content, const std::string& name) : text(content), file(name) {}

    std::vector<Token> read() {
        checkEncoding();
        while (skipBlanks(), at < text.size()) readToken();
        add(Kind::End, at);
        return std::move(found);
    }

private:
    [[noreturn]] void fail(const std::string& what) const { throw MofError(file, line, what); }

    void checkEncoding() {
        const auto bad = utf8::find_invalid(text.begin(), text.end());
        if (bad == text.end()) return;
        line += static_cast<std::size_t>(std::count(text.begin(), bad, '\n'));
        fail("the text is not UTF-8");
    }

    /// A character, or NUL behind the end.
    char peek(std::size_t position) const { return position < text.size() ? text[position] : '\0'; }

    /// Where the characters of a kind end that begin at a position.
    template <class Belongs>
    std::size_t past(std::size_t position, Belongs belongs) const {
        while (position < text.size() && belongs(text[position])) ++position;
        return position;
    }

    void moveTo(std::size_t end) {
        line += static_cast<std::size_t>(std::count(text.begin() + static_cast<std::ptrdiff_t>(at),
                                                    text.begin() + static_cast<std::ptrdiff_t>(end), '\n'));
        at = end;
    }

    void add(Kind kind, std::size_t end) {
        found.push_back({kind, std::string(text.substr(at, end - at)), line});
        moveTo(end);
    }

    void skipBlanks() {
        for (;;) {
            const std::string_view next = text.substr(at, 2);
            if (!next.empty() && blanks.find(next.front()) != std::string_view::npos) {
                moveTo(at + 1);
            } else if (next == "//") {
                moveTo(std::min(text.find('\n', at), text.size()));
            } else if (next == "/*") {
                const std::size_t end = text.find("*/", at + 2);
                if (end == std::string_view::npos) fail("the comment does not end");
                moveTo(end + 2);
            } else {
                return;
            }
        }
    }

    void readToken() {
        const char first = text[at];
        if (first == '"') return readString();
        if (isLetter(first) || first == '_') return add(Kind::Name, past(at, isInName));
        if (first == '#') return add(Kind::Pragma, past(at + 1, isLetter));
        if (marks.find(first) != std::string_view::npos) return add(Kind::Mark, at + 1);
        if (!readReal() && !readInteger()) fail("unexpected character '" + character(at) + '\'');
    }

    bool readReal() {
        const std::size_t point = past(at + isSign(text[at]), om::isDigit);
        if (peek(point) != '.' || !om::isDigit(peek(point + 1))) return false;
        std::size_t end = past(point + 1, om::isDigit);
        if (om::lower(peek(end)) == 'e') {
            const std::size_t exponent = end + 1 + isSign(peek(end + 1));
            if (om::isDigit(peek(exponent))) end = past(exponent, om::isDigit);
        }
        add(Kind::Real, end);
        return true;
    }

    bool readInteger() {
        const std::size_t digits = at + isSign(text[at]);
        if (!om::isDigit(peek(digits))) return false;
        const bool hex = text[digits] == '0' && om::lower(peek(digits + 1)) == 'x' && isHexDigit(peek(digits + 2));
        add(Kind::Integer, hex ? past(digits + 2, isHexDigit) : past(digits, om::isDigit));
        return true;
    }

    void readString() {
        std::string value;
        std::size_t end = at + 1;
        while (peek(end) != '"') {
            if (end >= text.size() || text[end] == '\n') fail("the string does not end on its line");
            if (text[end] == '\\')
                value += unescaped(++end);
            else
                value += text[end];
            ++end;
        }
        found.push_back({Kind::String, std::move(value), line});
        moveTo(end + 1);
    }

    char unescaped(std::size_t position) const {
        if (position >= text.size()) fail("the string does not end on its line");
        const std::size_t escape = escapes.find(text[position]);
        if (escape == std::string_view::npos) fail("unknown escape '\\" + character(position) + "' in a string");
        return escaped[escape];
    }

    /// The character whose first byte that is.
    std::string character(std::size_t position) const {
        const std::size_t end =
            past(position + 1, [](char c) { return (static_cast<unsigned char>(c) & 0xC0) == 0x80; });
        return std::string(text.substr(position, end - position));
    }

    std::string_view text;
    const std::string& file;
    std::vector<Token> found;
    std::size_t at = 0;
    std::size_t line = 1;
};

} // namespace

std::vector<Token> readTokens(std::string_view text, const std::string& file) {
    return Lexer(text, file).read();
}

} // namespace mof
