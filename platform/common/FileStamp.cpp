#include "common/FileStamp.h"

#include <cerrno>
#include <ctime>

namespace VK {

namespace {

constexpr std::int64_t clockTick = 20'000'000;

std::int64_t nanoseconds(const timespec& time) {
    return std::int64_t{time.tv_sec} * 1'000'000'000 + time.tv_nsec;
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
    return error != 0 || changed + clockTick < instant || changed > instant + clockTick;
}

} // namespace VK
