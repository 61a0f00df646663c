#include "objectmanager/endpoint/Log.h"

#include <poll.h>
#include <unistd.h>

#include <cerrno>
#include <mutex>

namespace endpoint {
namespace {

/// A character of a line, those of `special` escaped as well as those that cannot be printed.
std::string printable(char c, std::string_view special) {
    constexpr const char* digits = "0123456789abcdef";
    const auto byte = static_cast<unsigned char>(c);
    if (byte >= 0x20 && byte < 0x7f && special.find(c) == std::string_view::npos) return {c};
    return {'\\', 'x', digits[byte >> 4U], digits[byte & 0xFU]};
}

/// As much of a text as its escapes leave room for.
std::string printable(std::string_view text, std::size_t longest, std::string_view special = {}) {
    std::string line;
    for (const char c : text) {
        const std::string shown = printable(c, special);
        if (line.size() + shown.size() > longest) break;
        line += shown;
    }
    return line;
}

} // namespace

void log(std::string_view line) {
    constexpr std::size_t longest = 1024; // the journal makes several lines of very long ones
    const std::string whole = "vkcimd: " + printable(line, longest) + '\n';
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
    const std::string shown = printable(text, longest, "\"\\");
    return text.find_first_of(" \"") == std::string_view::npos ? shown : '"' + shown + '"';
}

std::string detailed(std::string_view text) {
    constexpr std::size_t longest = 256;
    return printable(text, longest);
}

} // namespace endpoint
