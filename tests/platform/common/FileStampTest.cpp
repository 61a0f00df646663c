#include "common/FileStamp.h"

#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace VK {

namespace {

constexpr std::int64_t second = 1'000'000'000;

FileStamp changedAt(time_t seconds, long nanoseconds) {
    struct stat status {};
    status.st_ctim = {seconds, nanoseconds};
    return FileStamp(status);
}

TEST(FileStamp, TellsChangesOnceTheClockThatMadeItHasTicked) {
    const FileStamp fine = changedAt(100, 1);
    EXPECT_FALSE(fine.tellsChangesFrom(100 * second + 20'000'001));
    EXPECT_TRUE(fine.tellsChangesFrom(100 * second + 20'000'002));
}

TEST(FileStamp, OfWholeSecondsTellsChangesTwoSecondsLater) {
    const FileStamp coarse = changedAt(100, 0);
    EXPECT_FALSE(coarse.tellsChangesFrom(102 * second));
    EXPECT_TRUE(coarse.tellsChangesFrom(102 * second + 1));
}

TEST(FileStamp, ThatLiesAheadTellsChangesOnlyOutsideATick) {
    const FileStamp ahead = changedAt(100, 1);
    EXPECT_FALSE(ahead.tellsChangesFrom(100 * second - 19'999'999));
    EXPECT_TRUE(ahead.tellsChangesFrom(100 * second - 20'000'000));
}

TEST(FileStamp, IsExactOnADiskAlsoForAFileThatIsMissing) {
    const support::TemporaryDirectory directory;
    directory.write("file", "");
    const bool onDisk = hasExactStamps(directory.path("file"));
    EXPECT_EQ(hasExactStamps(directory.path("missing")), onDisk);
    EXPECT_TRUE(hasExactStamps("/dev/shm/missing")); // in memory
}

TEST(FileStamp, IsNotExactForFilesOfTheKernel) {
    EXPECT_FALSE(hasExactStamps("/proc/uptime"));
    EXPECT_FALSE(hasExactStamps("/proc/missing"));
    if (std::filesystem::exists("/sys/kernel/mm")) { // where /sys is mounted
        EXPECT_FALSE(hasExactStamps("/sys/kernel"));
    }
    EXPECT_FALSE(hasExactStamps("/no/such/directory"));
}

} // namespace

} // namespace VK
