#include "objectmanager/vkcim/Terminal.h"

#include <langinfo.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <algorithm>
#include <charconv>
#include <clocale>
#include <cstdlib>
#include <cstring>

namespace vkcim {
namespace {

constexpr std::size_t narrowest = 20;

std::string_view variable(const char* name) {
    const char* value = std::getenv(name);
    return value != nullptr ? value : "";
}

bool wantsColours() {
    const std::string_view terminal = variable("TERM");
    return isatty(STDOUT_FILENO) == 1 && variable("NO_COLOR").empty() && !terminal.empty() && terminal != "dumb";
}

bool isUtf8Locale() {
    const locale_t locale = newlocale(LC_CTYPE_MASK, "", nullptr);
    if (locale == nullptr) return false;
    const bool isUtf8 = std::strcmp(nl_langinfo_l(CODESET, locale), "UTF-8") == 0;
    freelocale(locale);
    return isUtf8;
}

/// COLUMNS, else a terminal's width; 0 where there is neither.
std::size_t widthOf(int descriptor) {
    const std::string_view wanted = variable("COLUMNS");
    std::size_t width = 0;
    std::from_chars(wanted.data(), wanted.data() + wanted.size(), width);
    winsize size{};
    if (width == 0 && ioctl(descriptor, TIOCGWINSZ, &size) == 0) width = size.ws_col;
    return width == 0 ? 0 : std::max(width, narrowest);
}

/// Where the next character of a text starts; what a terminal takes for its colours counts as part of the character
/// before it.
std::size_t nextCharacter(std::string_view text, std::size_t at) {
    do {
        if (text[at] == '\x1b') at = std::min(text.find('m', at), text.size() - 1);
        ++at;
    } while (at < text.size() && (text[at] == '\x1b' || (static_cast<unsigned char>(text[at]) & 0xc0) == 0x80));
    return at;
}

std::size_t columns(std::string_view text) {
    std::size_t count = 0;
    for (std::size_t at = 0; at < text.size(); at = nextCharacter(text, at)) ++count;
    return count;
}

/// Where the text of a line's last column starts: behind its first two blanks in a row, or where the line itself
/// starts.
std::size_t startOfText(std::string_view line, std::size_t width) {
    const std::size_t first = std::min(line.find_first_not_of(' '), line.size());
    std::size_t column = line.find("  ", first);
    if (column != std::string_view::npos) column = line.find_first_not_of(' ', column);
    if (column != std::string_view::npos && columns(line.substr(0, column)) <= width / 2 + 4) return column;
    return line.substr(first, 2) == "- " ? first + 2 : first;
}

/// Where to break a line behind `from`: at the last place that leaves at most `room` columns, else at the first one.
/// Places are blanks, then commas. The whole line where there is none.
std::size_t breakOf(std::string_view line, std::size_t from, std::size_t room) {
    std::size_t blank = 0;
    std::size_t comma = 0;
    std::size_t count = columns(line.substr(0, from));
    for (std::size_t at = from; at < line.size(); at = nextCharacter(line, at), ++count) {
        if (count > room && (blank != 0 || comma != 0)) break;
        if (at == from) continue;
        if (line[at] == ' ') blank = at;
        if (line[at - 1] == ',' && line[at] != ' ') comma = at;
    }
    if (blank != 0) return blank;
    return comma != 0 ? comma : line.size();
}

void appendWrapped(std::string& to, std::string_view line, std::size_t width) {
    std::size_t from = startOfText(line, width);
    const std::size_t hanging = columns(line.substr(0, from));
    std::size_t indent = 0;
    while (indent + columns(line) > width) {
        const std::size_t end = breakOf(line, from, width - indent);
        const std::size_t rest = std::min(line.find_first_not_of(' ', end), line.size());
        if (rest == line.size()) break;
        to.append(indent, ' ').append(line.substr(0, line.find_last_not_of(' ', end - 1) + 1)) += '\n';
        indent = hanging + (rest == end ? 2 : 0); // more, so that the rest of a word does not look like a new one
        line.remove_prefix(rest);
        from = 0;
    }
    to.append(indent, ' ').append(line);
}

} // namespace

Look lookOfStandardOutput() {
    return {wantsColours(), isUtf8Locale(), widthOf(STDOUT_FILENO)};
}

std::size_t widthOfMessages() {
    return isatty(STDERR_FILENO) == 1 ? widthOf(STDERR_FILENO) : 0;
}

std::string wrapped(std::string_view text, std::size_t width) {
    std::string result;
    if (width == 0) return result.append(text);
    while (!text.empty()) {
        const std::size_t end = std::min(text.find('\n'), text.size());
        appendWrapped(result, text.substr(0, end), width);
        if (end < text.size()) result += '\n';
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return result;
}

} // namespace vkcim
