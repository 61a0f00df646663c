#include "objectmanager/cimxml/Escape.h"

#include <utf8.h>

#include <array>
#include <cstdint>
#include <iterator>

namespace cimxml {
namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD";

/// Nothing for a byte that stays as it is; beyond ASCII a look at the whole character decides.
using Table = std::array<std::string_view, 128>;

constexpr Table makeTable(bool attribute) {
    Table table{};
    for (std::size_t c = 0; c < 0x20; ++c) table[c] = replacement;
    table['\t'] = attribute ? "&#9;" : "";
    table['\n'] = attribute ? "&#10;" : "";
    table['\r'] = "&#13;";
    table['&'] = "&amp;";
    table['<'] = "&lt;";
    table['>'] = "&gt;";
    if (attribute) table['"'] = "&quot;";
    return table;
}

/// Whether a byte stays as it is.
using Plain = std::array<bool, 256>;

constexpr Plain makePlain(const Table& table) {
    Plain plain{};
    for (std::size_t c = 0; c < table.size(); ++c) plain[c] = table[c].empty();
    return plain;
}

constexpr Table textTable = makeTable(false);
constexpr Table attributeTable = makeTable(true);
constexpr Plain textPlain = makePlain(textTable);
constexpr Plain attributePlain = makePlain(attributeTable);

bool isNoCharacter(std::string_view utf8) {
    return utf8 == "\xEF\xBF\xBE" || utf8 == "\xEF\xBF\xBF";
}

/// Appends one character beyond ASCII and returns where the next one begins.
const char* appendWide(std::string& out, const char* at, const char* end) {
    const char* next = at;
    try {
        utf8::next(next, end);
    } catch (const utf8::exception&) {
        out += replacement;
        return at + 1;
    }
    const std::string_view character(at, static_cast<std::size_t>(next - at));
    out += isNoCharacter(character) ? replacement : character;
    return next;
}

void append(std::string& out, std::string_view text, const Table& table, const Plain& plain) {
    const char* const end = text.data() + text.size();
    for (const char* at = text.data();;) {
        const char* const first = at;
        while (at != end && plain[static_cast<unsigned char>(*at)]) ++at;
        out.append(first, at);
        if (at == end) return;
        const auto byte = static_cast<unsigned char>(*at);
        if (byte < table.size()) {
            out += table[byte];
            ++at;
        } else {
            at = appendWide(out, at, end);
        }
    }
}

} // namespace

void appendText(std::string& out, std::string_view text) {
    append(out, text, textTable, textPlain);
}

void appendAttribute(std::string& out, std::string_view text) {
    append(out, text, attributeTable, attributePlain);
}

} // namespace cimxml
