#include "common/FileLock.h"

#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cerrno>
#include <fcntl.h>
#include <optional>
#include <sys/stat.h>
#include <thread>

namespace VK {

namespace {

TEST(FileLock, IsHadByOneAtATime) {
    const support::TemporaryDirectory directory;
    std::optional<FileLock> held(std::in_place, AT_FDCWD, directory.path("lock"));
    EXPECT_EQ(held->error(), 0);
    std::atomic<bool> isIn{false};
    std::thread other([&] {
        const FileLock lock(AT_FDCWD, directory.path("lock"));
        EXPECT_EQ(lock.error(), 0);
        isIn = true;
    });
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    EXPECT_FALSE(isIn);
    held.reset();
    other.join();
    EXPECT_TRUE(isIn);
}

TEST(FileLock, LeavesAFileThatOthersCannotOpen) {
    const support::TemporaryDirectory directory;
    { const FileLock lock(AT_FDCWD, directory.path("lock")); }
    struct stat status {};
    ASSERT_EQ(stat(directory.path("lock").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0600U);
}

TEST(FileLock, SaysWhyItIsNotHeld) {
    const support::TemporaryDirectory directory;
    directory.link("elsewhere", "lock");
    EXPECT_EQ(FileLock(AT_FDCWD, directory.path("lock")).error(), ELOOP);
    EXPECT_EQ(FileLock(AT_FDCWD, directory.path("missing/lock")).error(), ENOENT);
}

} // namespace

} // namespace VK
