#pragma once

#include <array>
#include <atomic>
#include <climits>
#include <cstddef>

namespace NVLog {

enum class Channel { Log, Trace };

/// What is logged and where to. Trivially destructible, so that threads may log while the process ends.
struct Settings {
    enum Sink { Syslog, Stderr, File, None };
    static constexpr std::size_t maxLevels = 64;

    Sink sink = Syslog;
    bool log = true;
    bool trace = false;
    bool traceInSyslog = false; ///< whether trace lines go there when the chosen sink cannot take them
    bool allLevels = false;
    std::size_t levelCount = 0;
    std::array<int, maxLevels> levels{};
    std::array<char, PATH_MAX> path{}; ///< of the File sink; behind what is looked at for every line
    std::array<char, 240> unknown{};   ///< what of the texts cannot be used, `NAME=ENTRY` each; empty where all can

    bool keeps(Channel channel, int level) const noexcept {
        if (!(channel == Channel::Log ? log : trace)) return false;
        if (allLevels) return true;
        for (std::size_t i = 0; i < levelCount; ++i) {
            if (levels[i] == level) return true;
        }
        return false;
    }
};

/// Reads the three variables' texts; null and empty ones mean the defaults. Entries of a list that cannot be used
/// are passed over and noted, and a list without any usable entry means the default: a typing error must not hide
/// failures. More than maxLevels levels keep all.
Settings parseSettings(const char* sink, const char* levels, const char* channels) noexcept;

/// This process's settings, once they are read.
struct KnownSettings {
    std::atomic<bool> known{false};
    Settings settings;
};
extern KnownSettings knownSettings;

const Settings& readSettings() noexcept;

/// This process's settings, read from the environment by the first caller.
inline const Settings& currentSettings() noexcept {
    return knownSettings.known.load(std::memory_order_acquire) ? knownSettings.settings : readSettings();
}

} // namespace NVLog
