#include "common/FileStamp.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <ctime>
#include <linux/magic.h>
#include <sys/vfs.h>

namespace VK {

namespace {

constexpr std::int64_t second = 1'000'000'000;

/// Of the clock that made a stamp, with a margin.
std::int64_t clockTick(std::int64_t stamp) {
    return stamp % second == 0 ? 2 * second : second / 50;
}

std::int64_t nanoseconds(const timespec& time) {
    return std::int64_t{time.tv_sec} * second + time.tv_nsec;
}

FileStamp stampOf(int result, const struct stat& status) {
    if (result == 0) return FileStamp(status);
    FileStamp stamp;
    stamp.error = errno;
    return stamp;
}

} // namespace

FileStamp::FileStamp(const struct stat& status)
    : identity(status.st_dev, status.st_ino, status.st_size, status.st_mtim.tv_sec, status.st_mtim.tv_nsec,
               status.st_ctim.tv_sec, status.st_ctim.tv_nsec),
      changed(nanoseconds(status.st_ctim)) {}

FileStamp FileStamp::of(const char* path) {
    struct stat status {};
    return stampOf(lstat(path, &status), status);
}

FileStamp FileStamp::behind(const char* path) {
    struct stat status {};
    return stampOf(stat(path, &status), status);
}

std::int64_t FileStamp::now() {
    timespec time{};
    clock_gettime(CLOCK_REALTIME, &time);
    return nanoseconds(time);
}

bool FileStamp::tellsChangesFrom(std::int64_t instant) const {
    // A stamp that lies ahead was made before the clock was set back: a change now has an earlier one.
    const std::int64_t tick = clockTick(changed);
    return error != 0 || changed + tick < instant || changed > instant + tick;
}

bool hasExactStamps(const std::string& file) {
    constexpr std::array<decltype(statfs::f_type), 8> exact{EXT4_SUPER_MAGIC,      BTRFS_SUPER_MAGIC, XFS_SUPER_MAGIC,
                                                            F2FS_SUPER_MAGIC,      TMPFS_MAGIC,       SQUASHFS_MAGIC,
                                                            OVERLAYFS_SUPER_MAGIC, 0x2FC12FC1 /* ZFS */};
    struct statfs status {};
    const std::string directory = file.substr(0, file.rfind('/') + 1);
    const bool found =
        statfs(file.c_str(), &status) == 0 || statfs(directory.empty() ? "." : directory.c_str(), &status) == 0;
    return found && std::find(exact.begin(), exact.end(), status.f_type) != exact.end();
}

} // namespace VK
