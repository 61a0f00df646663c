// A disk that is full or read-only, and a limit on file sizes: the old file stays whole, nothing is left beside it, and
// the process goes on.
#include "support/HostCopy.h"
#include "support/InChild.h"
#include "support/LogCapture.h"
#include "tree/SimulatedHost.h"
#include "zone/ZoneChange.h"
#include "zone/ZoneInForce.h"

#include <gmock/gmock.h>

#include <fcntl.h>
#include <sched.h>
#include <sys/mount.h>
#include <sys/resource.h>
#include <sys/stat.h>

namespace VK::Tree {

namespace {

using support::HostCopy;
using support::inChild;
using support::takeLog;
using testing::HasSubstr;
using testing::SizeIs;
using testing::UnorderedElementsAre;

constexpr const char* tree = R"({"nodes":[{"type":40,"path":"/c","properties":{"108":"node7"}}]})";
constexpr const char* forbidden = "no mounts here";

/// A file system of a few pages over a directory, in a mount namespace of this process's own.
bool mountOver(const std::string& directory) {
    if (unshare(CLONE_NEWNS) != 0) return false;
    if (mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0) return false;
    return mount("vk-test", directory.c_str(), "tmpfs", 0, "size=64k") == 0;
}

void fill(const std::string& directory) {
    const int fd = open((directory + "/filler").c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, 0600);
    const std::string page(4096, 'x');
    while (write(fd, page.data(), page.size()) > 0) {
    }
    close(fd);
}

bool makeReadOnly(const std::string& directory) {
    return mount(nullptr, directory.c_str(), nullptr, MS_REMOUNT | MS_RDONLY, nullptr) == 0;
}

bool makeWritable(const std::string& directory) {
    return mount(nullptr, directory.c_str(), nullptr, MS_REMOUNT, nullptr) == 0;
}

std::vector<std::string> namesIn(const std::string& directory) {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(directory)) names.push_back(entry.path().filename());
    return names;
}

bool exists(const support::TemporaryDirectory& directory, const std::string& name) {
    return std::filesystem::exists(directory.path(name));
}

/// Runs something in a process that may mount; skips the test where none may.
void mounting(const std::function<void()>& run, const std::string& directory) {
    const std::string outcome = inChild([&]() -> std::string {
        if (!mountOver(directory)) return forbidden;
        run();
        return "done";
    });
    if (outcome == forbidden) GTEST_SKIP() << "mounting a file system takes root, or a user namespace";
    EXPECT_EQ(outcome, "done");
}

/// Tries to write to a simulated host's file, which must stay as it is.
void expectUnwritten(const support::TemporaryDirectory& directory, const char* reason) {
    SimulatedHost host(directory.path("tree.json"));
    const auto before = host.tree();
    takeLog();
    const std::string large(8000, 'x');
    EXPECT_FALSE(host.write(*before->find("/c").node, 1, Value(large)));
    const auto lines = takeLog();
    EXPECT_THAT(lines, testing::ElementsAre(HasSubstr(reason)));
    EXPECT_EQ(directory.read("tree.json"), tree);
    EXPECT_FALSE(exists(directory, ".tree.json.vk-new"));
    EXPECT_EQ(host.read(*host.tree()->find("/c").node, 108), Value("node7"));
}

class FullDisk : public testing::Test {
protected:
    void SetUp() override { directory.write("keep", ""); }

    support::TemporaryDirectory directory;
};

TEST_F(FullDisk, LeavesASimulatedHostsFileWhole) {
    mounting(
        [this] {
            directory.write("tree.json", tree);
            fill(directory.path());
            expectUnwritten(directory, "No space left on device");
            std::filesystem::remove(directory.path("filler"));
            SimulatedHost host(directory.path("tree.json"));
            EXPECT_TRUE(host.write(*host.tree()->find("/c").node, 1, Value("x"))) << "there is room again";
        },
        directory.path());
}

TEST_F(FullDisk, ThatIsReadOnlyLeavesASimulatedHostsFileWhole) {
    mounting(
        [this] {
            directory.write("tree.json", tree);
            ASSERT_TRUE(makeReadOnly(directory.path()));
            expectUnwritten(directory, "Read-only file system");
        },
        directory.path());
}

TEST_F(FullDisk, WithASizeLimitLeavesASimulatedHostsFileWholeAndTheProcessRunning) {
    directory.write("tree.json", tree);
    EXPECT_EQ(inChild([this]() -> std::string {
                  rlimit before{};
                  getrlimit(RLIMIT_FSIZE, &before);
                  const rlimit limit{100, before.rlim_max};
                  setrlimit(RLIMIT_FSIZE, &limit); // SIGXFSZ would end the child
                  SimulatedHost host(directory.path("tree.json"));
                  const bool written = host.write(*host.tree()->find("/c").node, 1, Value(std::string(500, 'x')));
                  setrlimit(RLIMIT_FSIZE, &before);
                  return written ? "written" : "refused";
              }),
              "refused");
    EXPECT_EQ(directory.read("tree.json"), tree);
    EXPECT_FALSE(exists(directory, ".tree.json.vk-new"));
}

/// A change of zone that cannot be written: everything is as before, and one line says why.
void expectZoneUnchanged(const HostCopy& host) {
    const Root root(host.path());
    for (const auto& change : {+[](const Root& where) { return Zone::changeOffset(where, 345); },
                               +[](const Root& where) { return Zone::changeDaylightSaving(where, false); }}) {
        takeLog();
        EXPECT_FALSE(change(root));
        EXPECT_THAT(takeLog(), SizeIs(1));
        EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
        EXPECT_EQ(host.read("etc/timezone"), "Europe/Berlin\n");
        EXPECT_TRUE(Zone::hasDaylightSaving(root));
    }
}

class FullDiskOfZones : public testing::Test {
protected:
    void SetUp() override { host.useZone("Europe/Berlin"); }

    HostCopy host;
};

TEST_F(FullDiskOfZones, UnderTheStateChangesNothing) {
    std::filesystem::create_directories(host.path("var"));
    mounting(
        [this] {
            fill(host.path("var"));
            expectZoneUnchanged(host);
        },
        host.path("var"));
}

TEST_F(FullDiskOfZones, UnderTheZoneChangesNothingOrTheZoneAlone) {
    mounting(
        [this] {
            host.useZone("Europe/Berlin"); // on the new file system
            fill(host.path("etc"));
            const Root root(host.path());
            EXPECT_FALSE(Zone::changeOffset(root, 345)) << "a file of our own, for which there is no room";
            EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
            EXPECT_THAT(namesIn(host.path("etc")), UnorderedElementsAre("localtime", "timezone", "filler"));
            EXPECT_FALSE(host.exists("var/lib/vk/instrumentation/former-zone")) << "nothing was replaced";

            takeLog();
            EXPECT_TRUE(Zone::changeOffset(root, -300)) << "a link, which takes no room";
            EXPECT_EQ(Zone::offsetInForce(root), -300);
            EXPECT_EQ(host.read("etc/timezone"), "Europe/Berlin\n") << "the name is for people: the zone is in force";
            EXPECT_THAT(takeLog(), testing::Contains(HasSubstr("/etc/timezone does not follow")));
            EXPECT_TRUE(Zone::changeDaylightSaving(root, true));
            EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin") << "and it comes back";
            EXPECT_THAT(namesIn(host.path("etc")), UnorderedElementsAre("localtime", "timezone", "filler"));
        },
        host.path("etc"));
}

TEST_F(FullDiskOfZones, ThatIsReadOnlyChangesNothing) {
    mounting(
        [this] {
            host.useZone("Europe/Berlin");
            ASSERT_TRUE(makeReadOnly(host.path("etc")));
            expectZoneUnchanged(host);
            EXPECT_FALSE(host.exists("var/lib/vk/instrumentation/former-zone")) << "nothing was replaced";
        },
        host.path("etc"));
}

TEST_F(FullDiskOfZones, ThatIsReadOnlyKeepsTheZoneRememberedBefore) {
    mounting(
        [this] {
            host.useZone("Europe/Berlin");
            ASSERT_TRUE(Zone::changeOffset(Root(host.path()), 330));
            host.useZone("America/New_York");
            ASSERT_TRUE(makeReadOnly(host.path("etc")));
            EXPECT_FALSE(Zone::changeDaylightSaving(Root(host.path()), false));
            ASSERT_TRUE(makeWritable(host.path("etc")));
            host.useZone("Asia/Kolkata");
            ASSERT_TRUE(Zone::changeDaylightSaving(Root(host.path()), true));
            EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
        },
        host.path("etc"));
}

TEST_F(FullDiskOfZones, WithASizeLimitChangesNothingAndTheProcessGoesOn) {
    EXPECT_EQ(inChild([this]() -> std::string {
                  rlimit before{};
                  getrlimit(RLIMIT_FSIZE, &before);
                  const rlimit limit{10, before.rlim_max};
                  setrlimit(RLIMIT_FSIZE, &limit);
                  const bool changed = Zone::changeOffset(Root(host.path()), 345);
                  setrlimit(RLIMIT_FSIZE, &before);
                  return changed ? "changed" : "refused";
              }),
              "refused");
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
    EXPECT_EQ(host.read("etc/timezone"), "Europe/Berlin\n");
}

} // namespace

} // namespace VK::Tree
