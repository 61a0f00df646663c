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

/// Keeps of what cannot be used as much as there is room for, of a long entry its beginning.
void noteUnknown(Settings& settings, std::string_view name, std::string_view entry) noexcept {
    constexpr std::size_t longest = 40;
    char* at = settings.unknown.data() + std::char_traits<char>::length(settings.unknown.data());
    const char* const end = settings.unknown.data() + settings.unknown.size() - 1; // the last byte stays 0
    for (const std::string_view part : {std::string_view(settings.unknown[0] != 0 ? ", " : ""), name,
                                        std::string_view("="), entry.substr(0, longest)})
        at = std::copy_n(part.data(), std::min<std::size_t>(part.size(), static_cast<std::size_t>(end - at)), at);
}

void setSink(Settings& settings, std::string_view text) noexcept {
    constexpr std::string_view filePrefix = "file:";
    if (text.empty() || text == "syslog") return;
    const std::string_view file = text.substr(0, filePrefix.size()) == filePrefix ? text.substr(filePrefix.size()) : "";
    if (text == "stderr") {
        settings.sink = Settings::Stderr;
    } else if (text == "none") {
        settings.sink = Settings::None;
    } else if (!file.empty() && file.size() < settings.path.size()) {
        settings.sink = Settings::File;
        std::copy(file.begin(), file.end(), settings.path.begin());
    } else {
        noteUnknown(settings, "NVLOG_SINK", text);
    }
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
        int level{};
        const char* const end = entry.data() + entry.size();
        const auto [rest, error] = std::from_chars(entry.data(), end, level);
        if (entry == "all")
            settings.allLevels = true;
        else if (error == std::errc() && rest == end)
            addLevel(settings, level);
        else if (!entry.empty())
            noteUnknown(settings, "NVLOG_LEVELS", entry);
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
        if (!entry.empty() && entry != "log" && entry != "trace") noteUnknown(settings, "NVLOG_CHANNELS", entry);
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
    for (const Channel channel : {Channel::Log, Channel::Trace})
        knownSettings.bits[static_cast<std::size_t>(channel)] = knownSettings.settings.bits(channel);
}

} // namespace

std::uint64_t Settings::bits(Channel channel) const noexcept {
    if (!(channel == Channel::Log ? log : trace)) return 0;
    if (allLevels) return ~std::uint64_t{0};
    std::uint64_t found = 0;
    for (std::size_t i = 0; i < levelCount; ++i) found |= bitOf(levels[i]);
    return found;
}

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
