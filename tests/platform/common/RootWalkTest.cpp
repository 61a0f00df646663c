#include "common/RootWalk.h"

#include "support/TemporaryDirectory.h"

#include <array>
#include <cerrno>
#include <fcntl.h>
#include <gtest/gtest.h>

using support::TemporaryDirectory;
using VK::FileDescriptor;
using VK::RootWalk;

namespace {

/// What a file of the directory holds, or the walk's errno value as text.
std::string readByWalking(const std::string& directory, const std::string& path) {
    RootWalk walk(FileDescriptor(open(directory.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)));
    if (const int error = walk.walk(path, true); error != 0) return std::to_string(error);
    const FileDescriptor fd(walk.open(O_RDONLY, 0));
    std::array<char, 64> text{};
    const ssize_t length = read(fd.get(), text.data(), text.size());
    return length < 0 ? "unreadable" : std::string(text.data(), static_cast<std::size_t>(length));
}

} // namespace

TEST(RootWalk, FollowsLinksInsideTheRoot) {
    TemporaryDirectory directory;
    directory.write("a/b/file", "inside");
    directory.link("/a/b", "absolute");
    directory.link("../a/b", "a/relative");
    directory.link("../../../../a/b/file", "a/b/dots");
    for (const std::string path : {"/a/b/file", "a//b/./file", "/absolute/file", "/a/relative/file", "/a/b/dots",
                                   "/a/b/../../a/b/file", "/../../a/b/file", "/absolute/../b/file"})
        EXPECT_EQ(readByWalking(directory.path(), path), "inside") << path;
}

TEST(RootWalk, TellsWhyItCannotGoOn) {
    TemporaryDirectory directory;
    directory.write("file", "x");
    directory.link("loop", "loop");
    directory.link("/etc/passwd", "outside");
    EXPECT_EQ(readByWalking(directory.path(), "/none"), std::to_string(ENOENT));
    EXPECT_EQ(readByWalking(directory.path(), "/none/file"), std::to_string(ENOENT));
    EXPECT_EQ(readByWalking(directory.path(), "/file/more"), std::to_string(ENOTDIR));
    EXPECT_EQ(readByWalking(directory.path(), "/file/"), std::to_string(ENOTDIR));
    EXPECT_EQ(readByWalking(directory.path(), "/loop"), std::to_string(ELOOP));
    EXPECT_EQ(readByWalking(directory.path(), "/outside"), std::to_string(ENOENT));
}

TEST(RootWalk, StandsOnALinkThatItIsNotToFollow) {
    TemporaryDirectory directory;
    directory.link("gone", "link");
    RootWalk walk(FileDescriptor(open(directory.path().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)));
    EXPECT_EQ(walk.walk("/link", false), 0);
    EXPECT_EQ(walk.path(), "/link");
}

TEST(RootWalk, MakesAMissingLastName) {
    TemporaryDirectory directory;
    directory.write("a/other", "");
    directory.link("a/made", "link");
    RootWalk walk(FileDescriptor(open(directory.path().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)));
    EXPECT_EQ(walk.walk("/link", true), ENOENT);
    EXPECT_TRUE(walk.onlyLastNameIsMissing());
    const FileDescriptor fd(walk.open(O_WRONLY | O_CREAT, 0640));
    EXPECT_TRUE(fd);
    EXPECT_EQ(readByWalking(directory.path(), "/a/made"), "");
}

TEST(RootWalk, OffersToMakeNothingBelowAMissingDirectory) {
    TemporaryDirectory directory;
    RootWalk walk(FileDescriptor(open(directory.path().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)));
    EXPECT_EQ(walk.walk("/none/file", true), ENOENT);
    EXPECT_FALSE(walk.onlyLastNameIsMissing());
}
