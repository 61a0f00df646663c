#include "nvlog/NVLogger.h"

#include "nvlog/LogWatch.h"

#include "logger/FileSink.h"
#include "logger/Line.h"
#include "logger/Settings.h"
#include "logger/SyslogSink.h"
#include "logger/Write.h"

#include <atomic>
#include <cerrno>
#include <pthread.h>
#include <syslog.h>
#include <unistd.h>

namespace NVLog {

namespace {

std::atomic<const NVLogWatch*> watching{nullptr};

/// Of the lines of the logger itself, which are about its settings: no watch is shown them.
constexpr const char* ownCategory = "Norvane.Logger";

/// What a call must leave as it found it: errno, and the thread's cancelability (a cancellation in here could not be
/// thrown out of a function that throws nothing).
class CallerState {
public:
    CallerState() noexcept : error(errno) { pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, &cancelState); }
    ~CallerState() {
        pthread_setcancelstate(cancelState, nullptr);
        errno = error;
    }
    CallerState(const CallerState&) = delete;
    CallerState& operator=(const CallerState&) = delete;

private:
    int error;
    int cancelState = PTHREAD_CANCEL_ENABLE;
};

bool writeToSink(const Settings& settings, const Event& event) noexcept {
    if (settings.sink == Settings::Syslog) return false;
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    Line line;
    appendTime(line, now);
    line.append(' ');
    appendEvent(line, event);
    line.append('\n');
    if (line.failed()) return false;
    return settings.sink == Settings::File ? appendToFile(settings.path.data(), line.text())
                                           : writeLine(STDERR_FILENO, line.text());
}

int priorityOf(int level) noexcept {
    switch (level) {
    case 3000:
        return LOG_NOTICE;
    case 6000:
        return LOG_ERR;
    default:
        return LOG_DEBUG;
    }
}

void writeToSyslog(const Event& event) noexcept {
    Line line;
    appendEvent(line, event);
    line.append('\0');
    if (!line.failed()) sendToSyslog(priorityOf(event.level), line.text().data());
}

/// Out of line, so that a dropped line costs its caller nothing of this.
__attribute__((noinline)) void write(Channel channel, const char* function, const char* file, int line,
                                     const std::string& category, int level, const std::string& text) noexcept {
    const Settings& settings = currentSettings();
    const Event event = {channel, function, file, line, category, level, text};
    const CallerState state;
    if (const NVLogWatch* const watch = watching.load();
        watch != nullptr && channel == Channel::Log && category != ownCategory)
        watch->take(watch->context, level, text.c_str());
    if (writeToSink(settings, event)) return;
    if (event.channel == Channel::Log || settings.sink == Settings::Syslog || settings.traceInSyslog)
        writeToSyslog(event);
}

/// Whoever reads the settings first writes one line on what of them cannot be used, whatever levels and channels are
/// kept: a typing error must not hide the lines that somebody waits for.
__attribute__((noinline)) const Settings& firstSettings() noexcept {
    const Settings& settings = readSettings();
    static std::atomic_flag announced = ATOMIC_FLAG_INIT;
    if (settings.unknown[0] == 0 || settings.sink == Settings::None || announced.test_and_set()) return settings;
    try {
        write(Channel::Log, "readSettings", "Settings", __LINE__, ownCategory, 6000,
              std::string("not understood: ") + settings.unknown.data());
    } catch (...) { // without memory there is no line
    }
    return settings;
}

bool isKept(Channel channel, int level) noexcept {
    if (!mayBeKept(channel, level)) return false;
    const bool known = knownSettings.known.load(std::memory_order_acquire);
    return (known ? knownSettings.settings : firstSettings()).keeps(channel, level);
}

} // namespace

void NVLogger::logLevelMessage(const char* function, const char* file, int line, const std::string& category, int level,
                               char*, int, int, const std::string& text) {
    if (isKept(Channel::Log, level)) write(Channel::Log, function, file, line, category, level, text);
}

void NVLogger::traceLevelMessage(const char* function, const char* file, int line, const std::string& category,
                                 int level, char*, int, int, const std::string& text) {
    if (isKept(Channel::Trace, level)) write(Channel::Trace, function, file, line, category, level, text);
}

} // namespace NVLog

void nvLogWatch(const NVLogWatch* watch) {
    NVLog::watching.store(watch);
}
