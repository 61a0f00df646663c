#include "tools/snapshot/Snapshot.h"

#include "support/SmbiosImage.h"
#include "support/TemporaryDirectory.h"
#include "tree/HostNodes.h"
#include "tree/RealHost.h"
#include "vk/NodeLexicon.h"

#include <array>
#include <gmock/gmock.h>
#include <sys/inotify.h>
#include <unistd.h>

namespace fs = std::filesystem;
using support::TemporaryDirectory;
using testing::Contains;
using testing::ElementsAre;
using VK::Root;

namespace snapshot {

namespace {

/// The files below a directory that are opened while this lives.
class OpenedFiles {
public:
    explicit OpenedFiles(const fs::path& directory) : watch(inotify_init1(IN_NONBLOCK)) {
        const auto add = [&](const fs::path& each) {
            names[inotify_add_watch(watch.get(), each.c_str(), IN_OPEN)] = "/" / each.lexically_relative(directory);
        };
        for (const fs::directory_entry& entry : fs::recursive_directory_iterator(directory))
            if (entry.is_directory()) add(entry.path());
    }

    std::set<std::string> take() {
        std::set<std::string> opened;
        alignas(inotify_event) std::array<char, 1 << 16> buffer{};
        const ssize_t length = ::read(watch.get(), buffer.data(), buffer.size());
        for (ssize_t at = 0; at < length;) {
            const auto* const event = reinterpret_cast<const inotify_event*>(buffer.data() + at);
            if (event->len > 0 && (event->mask & IN_ISDIR) == 0)
                opened.insert((names[event->wd] / static_cast<const char*>(event->name)).string());
            at += static_cast<ssize_t>(sizeof *event + event->len);
        }
        return opened;
    }

private:
    VK::FileDescriptor watch;
    std::map<int, fs::path> names;
};

class SnapshotTest : public testing::Test {
protected:
    void take(const std::function<void(const Root&)>& read, Snapshot::Options options = {}) {
        Target target(place);
        Snapshot snapshot(root, target, std::move(options));
        snapshot.take(read);
        problems = snapshot.problems();
    }

    std::string copied(const std::string& name) const { return parent.read("copy/" + name); }

    TemporaryDirectory host;
    TemporaryDirectory parent;
    fs::path place = parent.path("copy");
    Root root{host.path()};
    std::vector<std::string> problems;
};

/// A server with tables and without, as far as files say so.
void writeHost(const TemporaryDirectory& host) {
    Root::Record record;
    const TemporaryDirectory nothing;
    VK::Tree::readEverything(Root(nothing.path()).recordedIn(record));
    for (const std::string& path : record.read) host.write(path.substr(1), "text of " + path + "\n");
    support::SmbiosImage image(3, 2);
    image.add(support::SmbiosSystemImage{"Example", "RX200", "", "CZJ1234567", ""});
    image.add(support::SmbiosChassisImage{}).end().writeTo(host);
    for (const char* controller : {"mc0", "mc1"})
        host.write(std::string("sys/devices/system/edac/mc/") + controller + "/ue_count", "1\n");
    host.write("usr/share/zoneinfo/Europe/Berlin", "TZif2");
    fs::remove(host.path("etc/localtime"));
    host.link("/usr/share/zoneinfo/Europe/Berlin", "etc/localtime");
}

} // namespace

TEST_F(SnapshotTest, HoldsAFileThatReadingOpensForTheFirstTime) {
    host.write("etc/a-new-file", "told\n");
    take([](const Root& from) { from.read("/etc/a-new-file"); });
    EXPECT_EQ(copied("etc/a-new-file"), "told\n");
}

TEST_F(SnapshotTest, HoldsAllThatTheProviderOpens) {
    writeHost(host);
    OpenedFiles files(host.path());
    VK::Tree::RealHost provider(root);
    for (const unsigned int type : {VK::NodeLexicon::ComputerSystemNode, VK::NodeLexicon::SystemChassisNode})
        for (const VK::Tree::Node* node : provider.tree()->ofType(type)) {
            provider.status(*node);
            for (unsigned int property = 0; property < 1000; ++property) provider.read(*node, property);
        }
    std::set<std::string> opened = files.take();
    EXPECT_THAT(opened, Contains("/sys/firmware/dmi/tables/DMI"));
    EXPECT_THAT(opened, Contains("/usr/share/zoneinfo/Europe/Berlin"));
    EXPECT_THAT(opened, Contains("/sys/devices/system/edac/mc/mc1/ue_count"));
    opened.erase("/run/utmp"); // names users
    take(VK::Tree::readEverything);
    for (const std::string& name : opened) EXPECT_TRUE(fs::exists(place / name.substr(1))) << name;
}

TEST_F(SnapshotTest, HoldsWhatThisHostNeedNotBeAskedFor) {
    writeHost(host);
    take(VK::Tree::readEverything);
    for (const char* name : {"sys/class/dmi/id/chassis_serial", "sys/class/dmi/id/board_vendor",
                             "proc/device-tree/chassis-type", "run/systemd/shutdown/scheduled"})
        EXPECT_EQ(copied(name), std::string("text of /") + name + "\n");
    EXPECT_FALSE(fs::exists(place / "run/utmp"));
}

TEST_F(SnapshotTest, MasksAFileThatItDoesNotKnow) {
    host.write("etc/a-new-file", "serial 4711\n");
    Mask mask("salt");
    take([](const Root& from) { from.read("/etc/a-new-file"); }, {.mask = &mask});
    EXPECT_EQ(copied("etc/a-new-file").size(), 12U);
    EXPECT_EQ(copied("etc/a-new-file").find("4711"), std::string::npos);
}

TEST_F(SnapshotTest, HoldsTheZoneBehindLinkedDirectories) {
    host.write("private/zones/Europe/Berlin", "TZif2");
    host.link("/private/zones", "usr/share/zoneinfo");
    host.link("/usr/share/zoneinfo/Europe/Berlin", "private/etc/localtime");
    host.link("private/etc", "etc");
    take(VK::Tree::readEverything);
    EXPECT_EQ(fs::read_symlink(place / "etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
    EXPECT_EQ(copied("usr/share/zoneinfo/Europe/Berlin"), "TZif2");
    EXPECT_FALSE(fs::exists(place / "private"));
}

TEST_F(SnapshotTest, HoldsAZoneThatIsAFile) {
    host.write("etc/localtime", "TZif2");
    take(VK::Tree::readEverything);
    EXPECT_EQ(copied("etc/localtime"), "TZif2");
}

TEST_F(SnapshotTest, KeepsALinkThatLeadsNowhere) {
    host.link("/usr/share/zoneinfo/Gone", "etc/localtime");
    take(VK::Tree::readEverything);
    EXPECT_EQ(fs::read_symlink(place / "etc/localtime"), "/usr/share/zoneinfo/Gone");
    EXPECT_THAT(problems, ElementsAre());
}

TEST_F(SnapshotTest, LeavesOutWhatIsNoFileAndNamesWhatCannotBeRead) {
    fs::create_directories(host.path("etc/machine-info"));
    host.write("run/systemd", "a file in place of a directory");
    take(VK::Tree::readEverything);
    EXPECT_THAT(problems, ElementsAre("/run/systemd/shutdown/scheduled: Not a directory"));
    EXPECT_FALSE(fs::exists(place / "etc/machine-info"));
}

} // namespace snapshot
