#include "objectmanager/endpoint/Log.h"

#include <poll.h>
#include <unistd.h>

#include <cerrno>
#include <mutex>

namespace endpoint {
namespace {

std::string printable(std::string_view text) {
    constexpr const char* digits = "0123456789abcdef";
    std::string line;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte >= 0x20 && byte < 0x7f) {
            line += c;
        } else {
            line += "\\x";
            line += digits[byte >> 4U];
            line += digits[byte & 0xFU];
        }
    }
    return line;
}

} // namespace

void log(std::string_view line) {
    const std::string whole = "vkcimd: " + printable(line) + '\n';
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
    const std::string shown(text.substr(0, longest));
    return shown.find_first_of(" \"") == std::string::npos ? shown : '"' + shown + '"';
}

} // namespace endpoint
