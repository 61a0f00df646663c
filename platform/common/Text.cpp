#include "common/Text.h"

#include <utf8.h>

#include <algorithm>

namespace VK {

namespace {

using namespace std::literals;

bool isControl(unsigned char byte) {
    return byte < 0x20 || byte == 0x7F;
}

/// The length of the UTF-8 sequence that the text starts with; 0 when it is none.
std::size_t utf8Length(std::string_view text) {
    const char* position = text.data();
    try {
        utf8::next(position, text.data() + text.size());
    } catch (const utf8::exception&) {
        return 0;
    }
    return static_cast<std::size_t>(position - text.data());
}

} // namespace

std::string_view trimmed(std::string_view text) {
    constexpr std::string_view blanks = " \t\r\n\v\f\0"sv;
    const std::size_t begin = text.find_first_not_of(blanks);
    if (begin == std::string_view::npos) return {};
    return text.substr(begin, text.find_last_not_of(blanks) - begin + 1);
}

std::string printable(std::string_view text) {
    std::string result(text);
    std::replace_if(
        result.begin(), result.end(), [](char c) { return c < 0x20 || static_cast<unsigned char>(c) >= 0x7F; }, '.');
    return result;
}

std::string cleanText(std::string_view text) {
    return printable(trimmed(trimmed(text).substr(0, longestText)));
}

std::string cleanWrittenText(std::string_view text) {
    const std::string_view whole = text;
    text = trimmed(text);
    std::string result;
    while (!text.empty()) {
        const std::size_t length = utf8Length(text);
        if (length == 0) return cleanText(whole);
        if (result.size() + length > longestText) break;
        result += length == 1 && isControl(static_cast<unsigned char>(text.front())) ? "."sv : text.substr(0, length);
        text.remove_prefix(length);
    }
    return std::string(trimmed(result));
}

std::string lowerCase(std::string_view text) {
    std::string result(text);
    for (char& c : result)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    return result;
}

std::string_view firstLine(std::string_view text) {
    return text.substr(0, text.find_first_of("\r\n"));
}

std::string_view takeLine(std::string_view& text) {
    const std::size_t end = text.find('\n');
    const std::string_view line = text.substr(0, end);
    text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    return line;
}

std::string inQuotes(const std::string& text) {
    constexpr std::size_t longest = 64;
    const bool cut = text.size() > longest;
    return "\"" + printable(text.substr(0, longest)) + (cut ? "…\"" : "\"");
}

} // namespace VK
