#include "logger/Settings.h"

#include <algorithm>
#include <charconv>
#include <cstdlib>
#include <pthread.h>
#include <string_view>

namespace NVLog {

namespace {

std::string_view textOf(const char* value) noexcept {
    return value != nullptr ? value : std::string_view();
}

std::string_view trimmed(std::string_view text) noexcept {
    while (!text.empty() && text.front() == ' ') text.remove_prefix(1);
    while (!text.empty() && text.back() == ' ') text.remove_suffix(1);
    return text;
}

template <typename Use>
void forEachEntry(std::string_view list, Use use) noexcept {
    while (!list.empty()) {
        const std::size_t end = std::min(list.find(','), list.size());
        use(trimmed(list.substr(0, end)));
        list.remove_prefix(std::min(end + 1, list.size()));
    }
}

void setSink(Settings& settings, std::string_view text) noexcept {
    constexpr std::string_view filePrefix = "file:";
    if (text == "stderr") settings.sink = Settings::Stderr;
    if (text == "none") settings.sink = Settings::None;
    if (text.substr(0, filePrefix.size()) != filePrefix) return;
    text.remove_prefix(filePrefix.size());
    if (text.empty() || text.size() >= settings.path.size()) return;
    settings.sink = Settings::File;
    std::copy(text.begin(), text.end(), settings.path.begin());
}

void addLevel(Settings& settings, int level) noexcept {
    if (settings.levelCount == Settings::maxLevels) {
        settings.allLevels = true;
        return;
    }
    settings.levels[settings.levelCount++] = level;
}

void setLevels(Settings& settings, std::string_view list) noexcept {
    forEachEntry(list, [&settings](std::string_view entry) {
        if (entry == "all") settings.allLevels = true;
        int level = 0;
        const char* const end = entry.data() + entry.size();
        const auto [rest, error] = std::from_chars(entry.data(), end, level);
        if (error == std::errc() && rest == end) addLevel(settings, level);
    });
    if (settings.allLevels || settings.levelCount > 0) return;
    addLevel(settings, 3000);
    addLevel(settings, 6000);
}

void setChannels(Settings& settings, std::string_view list) noexcept {
    bool log = false;
    bool trace = false;
    forEachEntry(list, [&](std::string_view entry) {
        log = log || entry == "log";
        trace = trace || entry == "trace";
    });
    const bool chosen = log || trace;
    settings.log = log || !chosen;
    settings.trace = chosen ? trace : settings.sink != Settings::Syslog;
    settings.traceInSyslog = trace;
}

void readEnvironment() {
    knownSettings.settings =
        parseSettings(secure_getenv("NVLOG_SINK"), secure_getenv("NVLOG_LEVELS"), secure_getenv("NVLOG_CHANNELS"));
    knownSettings.known.store(true, std::memory_order_release);
}

} // namespace

Settings parseSettings(const char* sink, const char* levels, const char* channels) noexcept {
    Settings settings;
    setSink(settings, textOf(sink));
    setLevels(settings, textOf(levels));
    setChannels(settings, textOf(channels));
    if (settings.sink == Settings::None) settings.log = settings.trace = false;
    return settings;
}

KnownSettings knownSettings;

const Settings& readSettings() noexcept {
    // Unlike a static local's guard, this also works in the child of a fork in the middle of it.
    static pthread_once_t once = PTHREAD_ONCE_INIT;
    pthread_once(&once, &readEnvironment);
    return knownSettings.settings;
}

} // namespace NVLog
