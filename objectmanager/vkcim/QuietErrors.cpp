#include "objectmanager/vkcim/QuietErrors.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <string_view>

namespace vkcim {
namespace {

/// Whether a line begins as `2026-11-21T06:00:00.123456Z LOG `.
bool isLogLine(std::string_view line) {
    constexpr std::string_view time = "0000-00-00T00:00:00.000000Z ";
    if (line.size() < time.size()) return false;
    const bool begins = std::equal(time.begin(), time.end(), line.begin(), [](char pattern, char c) {
        return pattern == '0' ? c >= '0' && c <= '9' : pattern == c;
    });
    line.remove_prefix(time.size());
    return begins && (line.substr(0, 4) == "LOG " || line.substr(0, 6) == "TRACE ");
}

std::string contentOf(int descriptor) {
    std::string content;
    std::array<char, 65536> chunk;
    lseek(descriptor, 0, SEEK_SET);
    for (;;) {
        const ssize_t count = read(descriptor, chunk.data(), chunk.size());
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) return content;
        content.append(chunk.data(), static_cast<std::size_t>(count));
    }
}

void writeAll(int descriptor, std::string_view text) {
    while (!text.empty()) {
        const ssize_t count = write(descriptor, text.data(), text.size());
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) return;
        text.remove_prefix(static_cast<std::size_t>(count));
    }
}

} // namespace

QuietErrors::QuietErrors() : before(fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1)) {
    const int kept = memfd_create("standard-error", MFD_CLOEXEC);
    if (before >= 0 && kept >= 0) {
        // Standard output leads to the same place, as nobody but the program itself may print its answer.
        dup2(kept, STDERR_FILENO);
        dup2(kept, STDOUT_FILENO);
    } else if (before >= 0) {
        close(before);
        before = -1;
    }
    if (kept >= 0) close(kept);
}

QuietErrors::~QuietErrors() {
    if (before < 0) return;
    std::fflush(stdout); // what the library left in its buffer
    const std::string lines = logLinesOf(contentOf(STDERR_FILENO));
    dup2(before, STDERR_FILENO);
    dup2(before, STDOUT_FILENO);
    close(before);
    writeAll(STDERR_FILENO, lines);
}

std::string logLinesOf(const std::string& text) {
    std::string lines;
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t end = std::min(text.find('\n', at), text.size() - 1) + 1;
        const std::string_view line = std::string_view(text).substr(at, end - at);
        if (isLogLine(line)) lines += line;
        at = end;
    }
    return lines;
}

} // namespace vkcim
