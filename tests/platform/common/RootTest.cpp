#include "vk/Root.h"

#include "support/InChild.h"
#include "support/OpenDescriptors.h"
#include "support/TemporaryDirectory.h"

#include <cerrno>
#include <fcntl.h>
#include <gmock/gmock.h>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <sys/prctl.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

using support::openDescriptors;
using support::TemporaryDirectory;
using testing::ElementsAre;
using testing::StartsWith;
using VK::Root;

namespace {

/// From now on the kernel answers this process's openat2 with `error`, as sandboxes and old kernels do.
bool refuseOpenat2(int error) {
    sock_filter program[] = {
        BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, nr)),
        BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, SYS_openat2, 0, 1),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ERRNO | static_cast<unsigned int>(error)),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW),
    };
    const sock_fprog filter{4, program};
    return prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) == 0 && prctl(PR_SET_SECCOMP, SECCOMP_MODE_FILTER, &filter) == 0;
}

class SnapshotRoot : public testing::Test {
protected:
    TemporaryDirectory directory;
    Root root{directory.path()};
};

} // namespace

TEST_F(SnapshotRoot, ReadsAFile) {
    directory.write("etc/hostname", "node7\n");
    const Root::Contents contents = root.read("/etc/hostname");
    EXPECT_TRUE(contents);
    EXPECT_EQ(contents.text, "node7\n");
    EXPECT_FALSE(contents.truncated);
    EXPECT_EQ(root.read("etc/hostname").text, "node7\n");
}

TEST_F(SnapshotRoot, ReadsAnEmptyFileAsSuccess) {
    directory.write("etc/machine-id", "");
    EXPECT_TRUE(root.read("/etc/machine-id"));
    EXPECT_EQ(root.read("/etc/machine-id").text, "");
}

TEST_F(SnapshotRoot, RecordsWhatItIsAskedFor) {
    directory.link("hostname", "etc/name");
    Root::Record record;
    const Root recording = root.recordedIn(record);
    recording.read("/etc/hostname");
    recording.resolve("/etc");
    recording.readLink("/etc/name");
    recording.list("/etc");
    root.read("/etc/other");
    EXPECT_THAT(record.read, ElementsAre("/etc/hostname"));
    EXPECT_THAT(record.followed, ElementsAre("/etc", "/etc/name"));
}

TEST_F(SnapshotRoot, ReadsBytesAsTheyAre) {
    const std::string bytes("\0\xff\n\0", 4);
    directory.write("DMI", bytes);
    EXPECT_EQ(root.read("/DMI").text, bytes);
}

TEST_F(SnapshotRoot, TellsWhyAFileCannotBeRead) {
    directory.write("etc/file", "x");
    EXPECT_EQ(root.read("/etc/missing").error, ENOENT);
    EXPECT_EQ(root.read("/no/where").error, ENOENT);
    EXPECT_EQ(root.read("/etc").error, EISDIR);
    EXPECT_EQ(root.read("/etc/file/below").error, ENOTDIR);
    EXPECT_EQ(root.read(std::string("/etc/file\0x", 11)).error, EINVAL);
    EXPECT_EQ(Root(directory.path() + "/none").read("/etc/file").error, ENOENT);
}

TEST_F(SnapshotRoot, TellsAForbiddenFileFromAMissingOne) {
    directory.write("secret", "x");
    chmod(directory.path().c_str(), 0755);
    chmod(directory.path("secret").c_str(), 0);
    const std::string errors = support::inChild([this] {
        if (geteuid() == 0 && setuid(65534) != 0) return std::string("cannot become another user");
        return std::to_string(root.read("/secret").error) + " " + std::to_string(root.read("/none").error);
    });
    EXPECT_EQ(errors, std::to_string(EACCES) + " " + std::to_string(ENOENT));
}

TEST_F(SnapshotRoot, StaysInsideWithoutTheKernelsHelp) {
    directory.write("passwd", "inside");
    directory.link("../../../../../../passwd", "dots");
    directory.link("/etc/made", "link");
    directory.write("etc/other", "");
    for (const int error : {ENOSYS, EPERM, EAGAIN}) {
        const std::string texts = support::inChild([this, error] {
            if (!refuseOpenat2(error)) return std::string("cannot refuse system calls");
            const int fd = root.open("/link", O_WRONLY | O_CREAT, 0640);
            EXPECT_GE(fd, 0);
            close(fd);
            EXPECT_EQ(root.open("/none/file", O_WRONLY | O_CREAT, 0640), -ENOENT);
            EXPECT_EQ(root.read("/none").error, ENOENT);
            EXPECT_EQ(root.readLink("/dots").text, "../../../../../../passwd");
            EXPECT_THAT(root.list("/etc").names, ElementsAre("made", "other"));
            return root.read("/dots").text + " " + root.read("/../../passwd").text;
        });
        EXPECT_EQ(texts, "inside inside");
    }
}

TEST_F(SnapshotRoot, NeverWaitsForAFifo) {
    ASSERT_EQ(mkfifo((directory.path() + "/fifo").c_str(), 0600), 0);
    EXPECT_EQ(root.read("/fifo").error, EINVAL);
}

TEST_F(SnapshotRoot, ReadsAtMostTheLimit) {
    directory.write("big", std::string(Root::defaultLimit + 5, 'x'));
    directory.write("exact", std::string(Root::defaultLimit, 'x'));
    EXPECT_EQ(root.read("/big").text.size(), Root::defaultLimit);
    EXPECT_TRUE(root.read("/big").truncated);
    EXPECT_EQ(root.read("/exact").text.size(), Root::defaultLimit);
    EXPECT_FALSE(root.read("/exact").truncated);
    EXPECT_EQ(root.read("/big", 3).text, "xxx");
    EXPECT_EQ(root.read("/big", 0).text, "");
    EXPECT_TRUE(root.read("/big", 0).truncated);
}

TEST_F(SnapshotRoot, TakesAbsoluteLinksInsideTheRoot) {
    directory.write("usr/share/zoneinfo/Europe/Berlin", "TZif");
    directory.link("/usr/share/zoneinfo/Europe/Berlin", "etc/localtime");
    EXPECT_EQ(root.read("/etc/localtime").text, "TZif");
    EXPECT_EQ(root.readLink("/etc/localtime").text, "/usr/share/zoneinfo/Europe/Berlin");
    EXPECT_EQ(root.resolve("/etc/localtime").text, "/usr/share/zoneinfo/Europe/Berlin");
}

TEST_F(SnapshotRoot, NeverLeavesTheRoot) {
    TemporaryDirectory outside;
    outside.write("passwd", "outside");
    directory.write("passwd", "inside");
    directory.link("../../../../../../../../../../passwd", "dots");
    directory.link(outside.path() + "/passwd", "absolute");
    directory.link(outside.path(), "directory");
    EXPECT_EQ(root.read("/../../../../passwd").text, "inside");
    EXPECT_EQ(root.read("/dots").text, "inside");
    EXPECT_EQ(root.read("/absolute").error, ENOENT);
    EXPECT_EQ(root.read("/directory/passwd").error, ENOENT);
}

TEST_F(SnapshotRoot, GivesUpOnLinksThatGoRound) {
    directory.link("b", "a");
    directory.link("a", "b");
    EXPECT_EQ(root.read("/a").error, ELOOP);
    EXPECT_EQ(root.resolve("/a").error, ELOOP);
    EXPECT_TRUE(root.readLink("/a"));
}

TEST_F(SnapshotRoot, ReadsTheTargetOfABrokenLink) {
    directory.link("../gone", "link");
    EXPECT_EQ(root.readLink("/link").text, "../gone");
    EXPECT_FALSE(root.exists("/link"));
    EXPECT_EQ(root.resolve("/link").error, ENOENT);
    directory.write("file", "x");
    EXPECT_EQ(root.readLink("/file").error, EINVAL);
    EXPECT_EQ(root.readLink("/none").error, ENOENT);
}

TEST_F(SnapshotRoot, ListsADirectoryInOrder) {
    directory.write("edac/mc1/ue_count", "0");
    directory.write("edac/mc0/ue_count", "0");
    directory.write("edac/uevent", "");
    EXPECT_THAT(root.list("/edac").names, ElementsAre("mc0", "mc1", "uevent"));
    EXPECT_EQ(root.list("/none").error, ENOENT);
    EXPECT_EQ(root.list("/edac/uevent").error, ENOTDIR);
}

TEST_F(SnapshotRoot, ChecksWhetherSomethingExists) {
    directory.write("etc/file", "x");
    EXPECT_TRUE(root.exists("/etc/file"));
    EXPECT_TRUE(root.exists("/etc"));
    EXPECT_TRUE(root.exists("/"));
    EXPECT_FALSE(root.exists("/etc/none"));
}

TEST_F(SnapshotRoot, OpensForWritingBelowTheRootOnly) {
    directory.link("/etc/made", "link");
    directory.write("etc/other", "");
    const int fd = root.open("/link", O_WRONLY | O_CREAT, 0600);
    ASSERT_GE(fd, 0);
    EXPECT_EQ(fcntl(fd, F_GETFD) & FD_CLOEXEC, FD_CLOEXEC);
    EXPECT_EQ(write(fd, "x", 1), 1);
    close(fd);
    EXPECT_EQ(root.read("/etc/made").text, "x");
    struct stat status {};
    ASSERT_EQ(stat(directory.path("etc/made").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0600U);
    EXPECT_EQ(root.open("/none/file", O_WRONLY | O_CREAT, 0640), -ENOENT);
}

TEST_F(SnapshotRoot, TakesNoNoticeOfAModeWhereNothingIsMade) {
    directory.write("etc/other", "");
    const int fd = root.open("/etc/other", O_RDONLY, 0640);
    EXPECT_GE(fd, 0);
    close(fd);
}

TEST_F(SnapshotRoot, LeavesNoDescriptorOpen) {
    directory.write("etc/file", "x");
    directory.link("/etc/file", "link");
    const std::size_t before = openDescriptors();
    root.read("/link");
    root.read("/etc");
    root.readLink("/link");
    root.resolve("/link");
    root.list("/etc");
    root.list("/link");
    root.exists("/link");
    EXPECT_EQ(openDescriptors(), before);
}

TEST(LiveRoot, ReadsTheKernelsFilesWhichStateNoSize) {
    const Root root("/");
    EXPECT_TRUE(root.isLive());
    EXPECT_EQ(root.getDirectory(), "/");
    EXPECT_THAT(root.read("/proc/self/status").text, StartsWith("Name:\t"));
    EXPECT_EQ(root.read("/dev/null").error, EINVAL);
}

TEST(LiveRoot, BeginsAtTheRootWhereverTheProcessIs) {
    support::inOwnProcess([] {
        EXPECT_EQ(chdir("/proc"), 0);
        EXPECT_THAT(Root("/").read("proc/self/status").text, StartsWith("Name:\t"));
        EXPECT_EQ(Root("/").read("self/status").error, ENOENT);
        EXPECT_EQ(Root("/").read("/none").error, ENOENT);
        EXPECT_EQ(Root("/").open("/none", O_RDONLY), -ENOENT);
    });
}

TEST(LiveRoot, IsAlsoMeantByOtherSpellings) {
    EXPECT_TRUE(Root("/usr/..").isLive());
}

TEST(LiveRoot, ResolvesLinks) {
    TemporaryDirectory directory;
    directory.write("file", "x");
    directory.link("file", "link");
    const Root root("/");
    EXPECT_EQ(root.resolve(directory.path() + "/link").text, root.resolve(directory.path() + "/file").text);
}

TEST(RelativeRoot, IsTakenFromTheWorkingDirectoryOfItsMaking) {
    TemporaryDirectory directory;
    directory.write("host/etc/hostname", "node7");
    const int before = open(".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    ASSERT_EQ(chdir(directory.path().c_str()), 0);
    const Root root("host");
    ASSERT_EQ(fchdir(before), 0);
    close(before);
    EXPECT_EQ(root.read("/etc/hostname").text, "node7");
}
