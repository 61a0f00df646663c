#include "objectmanager/endpoint/Log.h"

#include <poll.h>
#include <unistd.h>

#include <cerrno>
#include <mutex>

namespace endpoint {
namespace {

enum class Word { Bare, Quoted }; ///< in which its own quotes and escapes are escaped

bool isPrintable(char c, Word word) {
    return c >= 0x20 && c < 0x7f && (word == Word::Bare || (c != '"' && c != '\\'));
}

/// Appends as much of a text as its escapes leave room for; what cannot be printed is escaped.
void appendPrintable(std::string& line, std::string_view text, std::size_t longest, Word word) {
    constexpr const char* digits = "0123456789abcdef";
    constexpr std::size_t escape = 4;
    for (std::size_t at = 0, room = longest; at < text.size();) {
        const std::size_t first = at;
        while (at < text.size() && at - first < room && isPrintable(text[at], word)) ++at;
        line.append(text, first, at - first);
        room -= at - first;
        if (at == text.size() || room < escape || isPrintable(text[at], word)) return;
        const auto byte = static_cast<unsigned char>(text[at++]);
        line += {'\\', 'x', digits[byte >> 4U], digits[byte & 0xFU]};
        room -= escape;
    }
}

std::string printable(std::string_view text, std::size_t longest, Word word) {
    std::string line;
    appendPrintable(line, text, longest, word);
    return line;
}

} // namespace

void log(std::string_view line) {
    constexpr std::size_t longest = 1024; // the journal makes several lines of very long ones
    std::string whole = "vkcimd: ";
    whole.reserve(line.size() + 16);
    appendPrintable(whole, line, longest, Word::Bare);
    whole += '\n';
    // In one piece, so that the lines of several threads do not mix. One thread at a time, so that the room that poll
    // saw is still there: whoever blocked here would hold up the whole service.
    static std::mutex writing;
    const std::lock_guard lock(writing);
    pollfd end = {STDERR_FILENO, POLLOUT, 0};
    if (poll(&end, 1, 0) == 0) return;
    while (write(STDERR_FILENO, whole.data(), whole.size()) < 0 && errno == EINTR) {
    }
}

std::string logged(std::string_view text) {
    constexpr std::size_t longest = 128;
    if (text.empty()) return "-";
    const std::string shown = printable(text, longest, Word::Quoted);
    return text.find_first_of(" \"") == std::string_view::npos ? shown : '"' + shown + '"';
}

std::string detailed(std::string_view text) {
    constexpr std::size_t longest = 256;
    return printable(text, longest, Word::Bare);
}

} // namespace endpoint
