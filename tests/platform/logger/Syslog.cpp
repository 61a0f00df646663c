#include "platform/logger/Syslog.h"

#include <atomic>
#include <cstdarg>
#include <cstdio>
#include <mutex>
#include <utility>

// The real functions' places are taken by name: the library's calls arrive here.

namespace {

std::mutex mutex;
std::vector<std::string> lines;
std::atomic<int> opened{0};

void collect(int priority, const char* format, va_list arguments) {
    std::string text(1 << 20, '\0');
    const int length = vsnprintf(text.data(), text.size(), format, arguments);
    text.resize(static_cast<std::size_t>(length));
    const std::lock_guard<std::mutex> lock(mutex);
    lines.push_back(std::to_string(priority) + " " + text);
}

} // namespace

#pragma GCC visibility push(default)

extern "C" {

void syslog(int priority, const char* format, ...);
void __syslog_chk(int priority, int flag, const char* format, ...);
void openlog(const char* ident, int option, int facility);
void closelog();

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

int openlogCalls() {
    return opened;
}
