#include "logger/Write.h"

#include <atomic>
#include <cerrno>
#include <csignal>
#include <ctime>
#include <pthread.h>
#include <sys/uio.h>
#include <unistd.h>

namespace NVLog {

namespace {

/// Whether the sink's last line has no line feed yet. There is one sink in a process.
std::atomic<bool> lineIsCut{false};

/// Keeps the signals of a failed write from the process, which may not expect them.
class WriteSignals {
public:
    WriteSignals() noexcept {
        sigemptyset(&ours);
        sigaddset(&ours, SIGPIPE);
        sigaddset(&ours, SIGXFSZ);
        pthread_sigmask(SIG_BLOCK, &ours, &before);
    }
    ~WriteSignals() { pthread_sigmask(SIG_SETMASK, &before, nullptr); }
    WriteSignals(const WriteSignals&) = delete;
    WriteSignals& operator=(const WriteSignals&) = delete;

    /// Takes back the signal that the failed write sent to this thread, unless the thread had it blocked anyway.
    void takeBack(int error) const noexcept {
        const int signal = error == EPIPE ? SIGPIPE : SIGXFSZ;
        if ((error != EPIPE && error != EFBIG) || sigismember(&before, signal) == 1) return;
        sigset_t set;
        sigemptyset(&set);
        sigaddset(&set, signal);
        const timespec atOnce{};
        while (sigtimedwait(&set, nullptr, &atOnce) < 0 && errno == EINTR) {
        }
    }

private:
    sigset_t ours{};
    sigset_t before{};
};

/// writev so that a missing line feed and the line still are one write.
ssize_t writeOnce(int descriptor, std::string_view line, bool endLineBefore) noexcept {
    char lineFeed = '\n';
    const iovec parts[] = {{&lineFeed, 1}, {const_cast<char*>(line.data()), line.size()}};
    ssize_t count{};
    do {
        count = endLineBefore ? writev(descriptor, parts, 2) : write(descriptor, line.data(), line.size());
    } while (count < 0 && errno == EINTR);
    return endLineBefore && count > 0 ? count - 1 : count;
}

} // namespace

bool writeLine(int descriptor, std::string_view line) noexcept {
    const WriteSignals signals;
    bool endLineBefore = lineIsCut.exchange(false);
    std::size_t written = 0;
    while (written < line.size()) {
        const ssize_t count = writeOnce(descriptor, line.substr(written), endLineBefore);
        if (count < 0) signals.takeBack(errno);
        if (count < 0 || (count == 0 && !endLineBefore)) {
            if (written > 0 || endLineBefore) lineIsCut = true;
            return false;
        }
        endLineBefore = false;
        written += static_cast<std::size_t>(count);
    }
    return true;
}

} // namespace NVLog
