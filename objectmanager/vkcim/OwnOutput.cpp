#include "objectmanager/vkcim/OwnOutput.h"

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

namespace vkcim {

namespace {

/// Makes standard output lead to standard error. Returns a descriptor of what standard output was before, which
/// commands do not inherit; -1 where it is closed.
int takeStandardOutput() {
    const int own = fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1);
    // A closed stream's number must stay taken: a file that got it would receive what others print.
    const int nowhere = fcntl(STDERR_FILENO, F_GETFD) < 0 ? open("/dev/null", O_RDWR) : -1;
    if (nowhere >= 0) dup2(nowhere, STDERR_FILENO);
    dup2(STDERR_FILENO, STDOUT_FILENO);
    if (nowhere > STDERR_FILENO) close(nowhere);
    return own;
}

} // namespace

OwnOutput::OwnOutput() : std::ostream(nullptr), buffer(takeStandardOutput()) {
    rdbuf(&buffer);
}

OwnOutput::Buffer::int_type OwnOutput::Buffer::overflow(int_type character) {
    if (traits_type::eq_int_type(character, traits_type::eof())) return traits_type::not_eof(character);
    const char one = traits_type::to_char_type(character);
    return xsputn(&one, 1) == 1 ? character : traits_type::eof();
}

std::streamsize OwnOutput::Buffer::xsputn(const char* text, std::streamsize size) {
    std::streamsize written = 0;
    while (written < size) {
        const ssize_t count = ::write(descriptor, text + written, static_cast<std::size_t>(size - written));
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) break;
        written += count;
    }
    return written;
}

} // namespace vkcim
