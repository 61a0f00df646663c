#pragma once

#include <cstdint>
#include <string>
#include <sys/stat.h>
#include <tuple>

namespace VK {

/// What a file was like when it was looked at: it shows whether the file is still the one that was read.
struct FileStamp {
    FileStamp() = default;
    explicit FileStamp(const struct stat& status);

    /// Of what stands at a path; for a link, of the link itself.
    static FileStamp of(const char* path);
    /// Of what a path leads to.
    static FileStamp behind(const char* path);

    /// Now, on the clock of `changed`.
    static std::int64_t now();
    /// Whether it shows every change from `instant` on. Two changes within one tick of the file system's clock leave
    /// the same stamp: a stamp that young may still be followed by a change that it does not show. A file system whose
    /// stamps are whole seconds ticks once in a second.
    bool tellsChangesFrom(std::int64_t instant) const;

    friend bool operator==(const FileStamp& a, const FileStamp& b) {
        return a.error == b.error && a.identity == b.identity;
    }

    std::tuple<dev_t, ino_t, off_t, time_t, long, time_t, long> identity{};
    std::int64_t changed = 0; ///< nanoseconds since 1970; set by the kernel alone, with every change
    int error = 0;            ///< why there is no file, instead of all else
};

/// Whether a file lies, or would lie, in a file system whose stamps show each change at once: a local one on disks or
/// in memory. Those of the kernel, of other hosts and of programs show some changes late, or not at all.
bool hasExactStamps(const std::string& file);

} // namespace VK
