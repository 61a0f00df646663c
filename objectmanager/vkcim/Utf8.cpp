#include "objectmanager/vkcim/Utf8.h"

#include <fmt/format.h>

namespace vkcim {
namespace {

struct Sequence {
    std::size_t length; ///< bytes that belong together
    bool valid;
};

struct Lead {
    unsigned char first, last;
    unsigned char lowestSecond, highestSecond; ///< rules out overlong forms, surrogates and what is above U+10FFFF
    std::size_t continuations;
};

constexpr Lead leads[] = {{0xc2, 0xdf, 0x80, 0xbf, 1}, {0xe0, 0xe0, 0xa0, 0xbf, 2}, {0xe1, 0xec, 0x80, 0xbf, 2},
                          {0xed, 0xed, 0x80, 0x9f, 2}, {0xee, 0xef, 0x80, 0xbf, 2}, {0xf0, 0xf0, 0x90, 0xbf, 3},
                          {0xf1, 0xf3, 0x80, 0xbf, 3}, {0xf4, 0xf4, 0x80, 0x8f, 3}};

Sequence sequenceAt(std::string_view text, std::size_t at) {
    const auto byte = [&](std::size_t index) { return static_cast<unsigned char>(text[index]); };
    if (byte(at) < 0x80) return {1, true};
    for (const Lead& lead : leads) {
        if (byte(at) < lead.first || byte(at) > lead.last) continue;
        for (std::size_t i = 1; i <= lead.continuations; ++i) {
            const unsigned char lowest = i == 1 ? lead.lowestSecond : 0x80;
            const unsigned char highest = i == 1 ? lead.highestSecond : 0xbf;
            if (at + i >= text.size() || byte(at + i) < lowest || byte(at + i) > highest) return {i, false};
        }
        return {lead.continuations + 1, true};
    }
    return {1, false};
}

} // namespace

std::string cleanUtf8(std::string_view text) {
    std::string clean;
    clean.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        const Sequence sequence = sequenceAt(text, at);
        clean += sequence.valid ? text.substr(at, sequence.length) : "\xef\xbf\xbd";
        at += sequence.length;
    }
    return clean;
}

std::string printable(std::string_view text) {
    std::string line;
    const std::string clean = cleanUtf8(text);
    for (std::size_t i = 0; i < clean.size(); ++i) {
        const auto byte = static_cast<unsigned char>(clean[i]);
        // U+0080 to U+009F are control characters as well: C2 80 to C2 9F.
        const bool c1 = byte == 0xc2 && static_cast<unsigned char>(clean[i + 1]) < 0xa0;
        if (byte == '\n') {
            line += "\\n";
        } else if (byte == '\t') {
            line += "\\t";
        } else if (byte == '\r') {
            line += "\\r";
        } else if (byte < 0x20 || byte == 0x7f) {
            line += fmt::format("\\x{:02x}", byte);
        } else if (c1) {
            line += fmt::format("\\x{:02x}", static_cast<unsigned char>(clean[++i]));
        } else {
            line += clean[i];
        }
    }
    return line;
}

} // namespace vkcim
