#include "objectmanager/cimxml/Document.h"

#include "objectmanager/cimxml/Errors.h"

#include <utf8.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <cstring>
#include <optional>

namespace cimxml {
namespace {

constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF";
constexpr std::array<std::string_view, 5> entities = {"amp", "lt", "gt", "quot", "apos"};

bool isXmlCharacter(std::uint32_t c) {
    if (c < 0x20) return c == '\t' || c == '\n' || c == '\r';
    return c < 0xD800 || (c >= 0xE000 && c < 0xFFFE) || (c >= 0x10000 && c <= 0x10FFFF);
}

std::uint32_t nextCharacter(const char*& at, const char* end) {
    try {
        return utf8::next(at, end);
    } catch (const utf8::exception&) {
        throw notWellFormed("the text is not UTF-8");
    }
}

/// Whether eight bytes are all between 0x20 and 0x7F.
bool arePlain(const char* at) {
    constexpr std::uint64_t highBits = 0x8080808080808080U;
    constexpr std::uint64_t blanks = 0x2020202020202020U;
    std::uint64_t bytes = 0;
    std::memcpy(&bytes, at, sizeof bytes);
    return ((bytes | (bytes - blanks)) & highBits) == 0;
}

void checkCharacters(std::string_view text) {
    const char* const end = text.data() + text.size();
    for (const char* at = text.data(); at != end;) {
        const auto byte = static_cast<unsigned char>(*at);
        if (end - at >= 8 && arePlain(at)) { // most of them
            at += 8;
        } else if (byte >= 0x20 && byte < 0x80) {
            ++at;
        } else if (!isXmlCharacter(nextCharacter(at, end))) {
            throw notWellFormed("a character that XML does not have");
        }
    }
}

/// The character that `&#60;` or `&#x3c;` stands for; `digits` is what lies between `&#` and `;`.
std::optional<std::uint32_t> referred(std::string_view digits) {
    const bool hexadecimal = !digits.empty() && digits.front() == 'x';
    if (hexadecimal) digits.remove_prefix(1);
    std::uint32_t character = 0;
    const auto [end, error] =
        std::from_chars(digits.data(), digits.data() + digits.size(), character, hexadecimal ? 16 : 10);
    if (digits.empty() || error != std::errc() || end != digits.data() + digits.size()) return std::nullopt;
    return character;
}

/// Walks over the markup alone, so that a parser never sees what must not be expanded or followed.
class Markup {
public:
    Markup(std::string_view whole, int limit) : text(whole), most(limit) {}

    void check() {
        while (at < text.size()) {
            if (text[at] != '<' && text[at] != '&') {
                ++at;
            } else if (text[at] == '&') {
                reference();
            } else if (!starts("<!") && !starts("<?")) { // most of them
                tag();
            } else if (starts("<!--")) {
                skipTo("-->", 4);
            } else if (starts("<![CDATA[")) {
                skipTo("]]>", 9);
            } else if (starts("<?")) {
                skipTo("?>", 2);
            } else {
                throw notValid("a document type");
            }
        }
    }

private:
    bool starts(std::string_view with) const { return text.substr(at, with.size()) == with; }

    void skipTo(std::string_view end, std::size_t from) {
        const std::size_t found = text.find(end, at + from);
        if (found == std::string_view::npos) throw notWellFormed("markup that does not end");
        at = found + end.size();
    }

    void reference() {
        constexpr std::size_t longest = 10; // &#x10FFFF;
        const std::size_t end = text.substr(0, std::min(text.size(), at + longest)).find(';', at);
        if (end == std::string_view::npos) throw notWellFormed("a reference that does not end");
        const std::string_view name = text.substr(at + 1, end - at - 1);
        if (!name.empty() && name.front() == '#') {
            const std::optional<std::uint32_t> character = referred(name.substr(1));
            if (!character || !isXmlCharacter(*character)) throw notWellFormed("a reference to no character");
        } else if (std::find(entities.begin(), entities.end(), name) == entities.end()) {
            throw notWellFormed("a reference to an unknown entity");
        }
        at = end + 1;
    }

    void tag() {
        const bool closing = starts("</");
        const bool empty = skipTag();
        if (closing) {
            --depth;
            return;
        }
        if (++elements > most) throw notValid("too many elements");
        if (!empty && ++depth > deepestElement) throw notValid("elements are nested too deeply");
    }

    /// Steps behind the tag, references in its attributes included; whether it closes itself.
    bool skipTag() {
        char quote = 0;
        for (++at; at < text.size(); ++at) {
            const char c = text[at];
            if (c > '>') continue; // a letter, and what else no markup is made of
            if (c == '&') {
                reference();
                --at;
            } else if (c == '<') {
                throw notWellFormed("'<' within a tag");
            } else if (quote != 0) {
                if (c == quote) quote = 0;
            } else if (c == '"' || c == '\'') {
                quote = c;
            } else if (c == '>') {
                return text[at++ - 1] == '/';
            }
        }
        throw notWellFormed("a tag that does not end");
    }

    std::string_view text;
    std::size_t at = 0;
    int depth = 0;
    int most;
    int elements = 0;
};

} // namespace

void load(pugi::xml_document& document, std::string_view text, int most) {
    if (text.substr(0, byteOrderMark.size()) == byteOrderMark) text.remove_prefix(byteOrderMark.size());
    checkCharacters(text);
    Markup(text, most).check();
    const pugi::xml_parse_result result = document.load_buffer(
        text.data(), text.size(), pugi::parse_default | pugi::parse_declaration | pugi::parse_ws_pcdata_single,
        pugi::encoding_utf8);
    if (!result) throw notWellFormed(result.description());
    int roots = 0;
    for (const pugi::xml_node& node : document) {
        if (node.type() == pugi::node_element) ++roots;
    }
    if (roots != 1) throw notWellFormed("a document has one outermost element");
}

} // namespace cimxml
