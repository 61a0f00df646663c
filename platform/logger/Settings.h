#pragma once

#include <array>
#include <atomic>
#include <climits>
#include <cstddef>
#include <cstdint>

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

    /// The bits of all levels that a channel keeps.
    std::uint64_t bits(Channel channel) const noexcept;
    /// One bit for many levels, and of its own for each of those in use.
    static constexpr std::uint64_t bitOf(int level) noexcept {
        return std::uint64_t{1} << ((static_cast<unsigned int>(level) >> 3U) & 63U);
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
    /// Those of the two channels, for a quick look; all until the settings are known.
    std::array<std::atomic<std::uint64_t>, 2> bits{~std::uint64_t{0}, ~std::uint64_t{0}};
};
extern KnownSettings knownSettings;

/// Whether a line of that level may be kept, in a few instructions: of most lines the answer is no.
inline bool mayBeKept(Channel channel, int level) noexcept {
    const std::uint64_t bits = knownSettings.bits[static_cast<std::size_t>(channel)].load(std::memory_order_relaxed);
    return (bits & Settings::bitOf(level)) != 0;
}

const Settings& readSettings() noexcept;

/// This process's settings, read from the environment by the first caller.
inline const Settings& currentSettings() noexcept {
    return knownSettings.known.load(std::memory_order_acquire) ? knownSettings.settings : readSettings();
}

} // namespace NVLog
