#include "platform/logger/Syslog.h"

#include <atomic>
#include <cstdarg>
#include <cstdio>
#include <dlfcn.h>
#include <mutex>
#include <set>
#include <sys/socket.h>
#include <sys/un.h>
#include <syslog.h>
#include <utility>

// The real functions' places are taken by name: the library's calls arrive here.

namespace {

std::mutex lockOfSyslog;
std::mutex mutex;
std::vector<std::string> lines;
std::vector<std::string> directLines;
std::set<int> daemons; ///< the descriptors that were connected to /dev/log
std::atomic<int> opened{0};

void collect(int priority, const char* format, va_list arguments) {
    const std::lock_guard<std::mutex> syslogsOwn(lockOfSyslog);
    std::string text(1 << 20, '\0');
    const int length = vsnprintf(text.data(), text.size(), format, arguments);
    text.resize(static_cast<std::size_t>(length));
    const std::lock_guard<std::mutex> lock(mutex);
    lines.push_back(std::to_string(priority) + " " + text);
}

/// A line as syslog's daemon receives it: `<PRIORITY>NAME[PROCESS]: TEXT`.
void collectDirect(const std::string& message) {
    const std::size_t text = message.find("]: ");
    const std::lock_guard<std::mutex> lock(mutex);
    directLines.push_back(message);
    lines.push_back(std::to_string(LOG_PRI(std::stoi(message.substr(1)))) + " " + message.substr(text + 3));
}

bool isDaemon(int descriptor) {
    const std::lock_guard<std::mutex> lock(mutex);
    return daemons.count(descriptor) == 1;
}

/// The C library's own function, which ours stands before.
template <class Function>
Function* original(const char* name) {
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

} // namespace

#pragma GCC visibility push(default)

extern "C" {

void __syslog_chk(int priority, int flag, const char* format, ...);

int connect(int descriptor, const sockaddr* address, socklen_t length) {
    const auto* const local = reinterpret_cast<const sockaddr_un*>(address);
    if (address->sa_family != AF_UNIX || std::string(local->sun_path) != "/dev/log")
        return original<int(int, const sockaddr*, socklen_t)>("connect")(descriptor, address, length);
    const std::lock_guard<std::mutex> lock(mutex);
    daemons.insert(descriptor);
    return 0;
}

ssize_t send(int descriptor, const void* bytes, size_t size, int flags) {
    if (!isDaemon(descriptor))
        return original<ssize_t(int, const void*, size_t, int)>("send")(descriptor, bytes, size, flags);
    collectDirect(std::string(static_cast<const char*>(bytes), size));
    return static_cast<ssize_t>(size);
}

void syslog(int priority, const char* format, ...) {
    va_list arguments;
    va_start(arguments, format);
    collect(priority, format, arguments);
    va_end(arguments);
}

// What a fortified library calls instead.
void __syslog_chk(int priority, int, const char* format, ...) {
    va_list arguments;
    va_start(arguments, format);
    collect(priority, format, arguments);
    va_end(arguments);
}

void openlog(const char*, int, int) {
    ++opened;
}
void closelog() {
    ++opened;
}
}

std::vector<std::string> takeSyslog() {
    const std::lock_guard<std::mutex> lock(mutex);
    return std::exchange(lines, {});
}

std::vector<std::string> takeDirectLines() {
    const std::lock_guard<std::mutex> lock(mutex);
    return std::exchange(directLines, {});
}

SyslogIsBusy::SyslogIsBusy() {
    lockOfSyslog.lock();
}

SyslogIsBusy::~SyslogIsBusy() {
    lockOfSyslog.unlock();
}

int openlogCalls() {
    return opened;
}
