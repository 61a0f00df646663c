#include "objectmanager/vkcim/Utf8.h"

#include <fmt/format.h>
#include <nlohmann/json.hpp>
#include <utf8.h>

#include <iterator>

namespace vkcim {
namespace {

bool isControl(char32_t c) {
    return c < 0x20 || (c >= 0x7f && c < 0xa0);
}

void appendPrintable(std::string& line, char32_t c) {
    switch (c) {
    case '\n':
        line += "\\n";
        return;
    case '\t':
        line += "\\t";
        return;
    case '\r':
        line += "\\r";
        return;
    default:
        if (isControl(c))
            line += fmt::format("\\x{:02x}", static_cast<unsigned int>(c));
        else
            utf8::unchecked::append(c, std::back_inserter(line));
    }
}

} // namespace

std::string cleanUtf8(std::string_view text) {
    if (utf8::is_valid(text.begin(), text.end())) return std::string(text);
    const std::string quoted = nlohmann::json(text).dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
    return nlohmann::json::parse(quoted).get<std::string>();
}

std::string printable(std::string_view text) {
    const std::string clean = cleanUtf8(text);
    std::string line;
    for (const char* position = clean.data(); position != clean.data() + clean.size();)
        appendPrintable(line, utf8::unchecked::next(position));
    return line;
}

std::string shortened(std::string_view text) {
    constexpr std::size_t head = 240;
    constexpr std::size_t tail = 160;
    if (text.size() <= 2 * (head + tail)) return printable(text);
    return printable(text.substr(0, head)) + " ... " + printable(text.substr(text.size() - tail));
}

} // namespace vkcim
