#include "logger/SyslogSink.h"

#include "logger/Line.h"
#include "vk/FileDescriptor.h"

#include <atomic>
#include <cerrno>
#include <cstring>
#include <paths.h>
#include <pthread.h>
#include <sys/single_threaded.h>
#include <sys/socket.h>
#include <sys/time.h>
#include <sys/un.h>
#include <syslog.h>
#include <unistd.h>

namespace NVLog {

namespace {

using VK::FileDescriptor;

std::atomic<bool> forkerIsAlone{true};
/// Whether a thread that this process does not have may hold the lock of the C library's syslog.
std::atomic<bool> lockMayBeLost{false};

void beforeFork() {
    forkerIsAlone = __libc_single_threaded != 0;
}

void inChildOfFork() {
    // A process that becomes a daemon before it starts threads keeps the C library's syslog, and with it the name and
    // the facility that were chosen with openlog.
    if (!forkerIsAlone) lockMayBeLost = true;
}

[[maybe_unused]] const int watched = pthread_atfork(&beforeFork, nullptr, &inChildOfFork);

/// A socket of that type that is connected to the daemon; none where its socket is missing or of another type.
FileDescriptor connectToDaemon(int type) noexcept {
    FileDescriptor daemon(socket(AF_UNIX, type | SOCK_CLOEXEC, 0));
    const timeval longestWait{1, 0}; // connecting to and sending to a daemon that reads nothing
    setsockopt(daemon.get(), SOL_SOCKET, SO_SNDTIMEO, &longestWait, sizeof longestWait);
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, _PATH_LOG, sizeof _PATH_LOG);
    const bool connected = connect(daemon.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
    return connected ? std::move(daemon) : FileDescriptor();
}

/// Without a time, which daemons then add: to know the local one takes another lock of the C library.
void appendHeader(Line& line, int priority) noexcept {
    line.append('<');
    line.append(LOG_USER | priority);
    line.append('>');
    line.append(program_invocation_short_name);
    line.append('[');
    line.append(static_cast<int>(getpid()));
    line.append("]: ");
}

void sendToDaemon(int priority, const char* text) noexcept {
    Line line;
    appendHeader(line, priority);
    line.append(text);
    line.append('\0'); // ends the message in a stream
    if (line.failed()) return;
    FileDescriptor daemon = connectToDaemon(SOCK_DGRAM);
    const bool isStream = !daemon;
    if (isStream) daemon = connectToDaemon(SOCK_STREAM);
    const std::string_view message = line.text().substr(0, line.text().size() - (isStream ? 0 : 1));
    while (daemon && send(daemon.get(), message.data(), message.size(), MSG_NOSIGNAL) < 0 && errno == EINTR) {
    }
}

} // namespace

void sendToSyslog(int priority, const char* text) noexcept {
    if (lockMayBeLost)
        sendToDaemon(priority, text);
    else
        syslog(priority, "%s", text);
}

} // namespace NVLog
