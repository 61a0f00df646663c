#include "common/AtomicFile.h"

#include "support/InChild.h"
#include "support/TemporaryDirectory.h"
#include "vk/FileDescriptor.h"

#include <gmock/gmock.h>

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <sys/resource.h>
#include <sys/stat.h>

namespace VK {

namespace {

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

class AtomicFile : public testing::Test {
protected:
    static FileDescriptor open(const std::string& path) {
        return FileDescriptor(::open(path.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    }
    std::vector<std::string> names() const {
        std::vector<std::string> found;
        for (const auto& entry : fs::directory_iterator(directory.path())) found.push_back(entry.path().filename());
        return found;
    }
    int replace(const std::string& name, const std::string& bytes) const {
        return replaceFile(opened.get(), name, bytes, {0640, geteuid(), getegid()});
    }

    support::TemporaryDirectory directory;
    FileDescriptor opened = open(directory.path());
};

TEST_F(AtomicFile, IsThereWithItsBytesAndModeAndNothingBesideIt) {
    EXPECT_EQ(replace("a", "first"), 0);
    EXPECT_EQ(replace("a", "second"), 0);
    EXPECT_EQ(directory.read("a"), "second");
    struct stat status {};
    ASSERT_EQ(stat(directory.path("a").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0640U);
    EXPECT_EQ(replaceLink(opened.get(), "b", "elsewhere"), 0);
    EXPECT_EQ(fs::read_symlink(directory.path("b")), "elsewhere");
    EXPECT_THAT(names(), UnorderedElementsAre("a", "b"));
}

TEST_F(AtomicFile, TakesThePlaceOfWhatACrashLeft) {
    directory.write(".a.vk-new", "half");
    EXPECT_EQ(replace("a", "whole"), 0);
    EXPECT_EQ(directory.read("a"), "whole");
    EXPECT_THAT(names(), ElementsAre("a"));
}

TEST_F(AtomicFile, LeavesWhatIsThereWhereTheNewOneHasNoPlace) {
    directory.write("a", "older");
    directory.write(".a.vk-new/in the way", "");
    EXPECT_EQ(replace("a", "newer"), EISDIR);
    EXPECT_EQ(replaceLink(opened.get(), "a", "newer"), EISDIR);
    EXPECT_EQ(directory.read("a"), "older");
}

TEST_F(AtomicFile, ReplacesNoDirectory) {
    directory.write("sub/kept", "");
    EXPECT_EQ(replace("sub", "newer"), EISDIR);
    EXPECT_TRUE(fs::exists(directory.path("sub/kept")));
    EXPECT_THAT(names(), ElementsAre("sub"));
}

TEST_F(AtomicFile, IsMovedByLinkingItUnderItsName) {
    directory.write("from/a", "kept");
    const FileDescriptor from = open(directory.path("from"));
    EXPECT_EQ(replaceByLinking(opened.get(), "a", from.get()), 0);
    EXPECT_EQ(replaceByLinking(opened.get(), "a", from.get()), 0) << "they are one file already";
    EXPECT_TRUE(fs::equivalent(directory.path("a"), directory.path("from/a")));
    EXPECT_EQ(replaceByLinking(opened.get(), "missing", from.get()), ENOENT);
    EXPECT_THAT(names(), UnorderedElementsAre("a", "from"));
}

TEST_F(AtomicFile, GoesAndMayHaveGoneBefore) {
    directory.write("a", "");
    EXPECT_EQ(removeFile(opened.get(), "a"), 0);
    EXPECT_EQ(removeFile(opened.get(), "a"), 0);
    EXPECT_THAT(names(), IsEmpty());
    directory.write("sub/kept", "");
    EXPECT_EQ(removeFile(opened.get(), "sub"), EISDIR);
}

/// Whether SIGXFSZ is blocked, and whether it is pending, after a write beyond the size limit failed.
void expectTooLarge(int error, bool blocked) {
    EXPECT_EQ(error, EFBIG);
    sigset_t signals;
    pthread_sigmask(SIG_SETMASK, nullptr, &signals);
    EXPECT_EQ(sigismember(&signals, SIGXFSZ), blocked ? 1 : 0);
    sigpending(&signals);
    EXPECT_EQ(sigismember(&signals, SIGXFSZ), blocked ? 1 : 0);
}

TEST_F(AtomicFile, BeyondTheSizeLimitFailsAndLeavesTheSignalToWhoBlockedIt) {
    directory.write("a", "older");
    for (const bool blocked : {false, true}) {
        support::inOwnProcess([&] {
            const rlimit limit = {4, 4};
            setrlimit(RLIMIT_FSIZE, &limit);
            sigset_t signals;
            sigemptyset(&signals);
            if (blocked) sigaddset(&signals, SIGXFSZ);
            pthread_sigmask(SIG_BLOCK, &signals, nullptr);
            expectTooLarge(replace("a", "a newer text"), blocked);
        });
        EXPECT_EQ(directory.read("a"), "older");
        EXPECT_THAT(names(), ElementsAre("a"));
    }
}

} // namespace

} // namespace VK
