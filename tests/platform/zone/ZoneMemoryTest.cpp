#include "zone/ZoneMemory.h"

#include "platform/zone/HostWithZones.h"
#include "zone/ZoneChange.h"
#include "zone/ZoneInForce.h"

#include <gmock/gmock.h>

#include <functional>
#include <sys/stat.h>

namespace VK::Zone {

namespace {

using support::takeLog;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

constexpr const char* berlin = "/usr/share/zoneinfo/Europe/Berlin";
const std::string memory = "var/lib/vk/instrumentation/former-zone";

class ZoneMemoryOfHost : public HostWithZones {
protected:
    ZoneMemoryOfHost() { host.useZone("Europe/Berlin"); }

    ino_t inodeOf(const std::string& name) const {
        struct stat status {};
        EXPECT_EQ(lstat(host.path(name).c_str(), &status), 0) << name;
        return status.st_ino;
    }
    std::vector<std::string> state() const { return root.list("/var/lib/vk/instrumentation").names; }

    const Root root{host.path()};
};

TEST_F(ZoneMemoryOfHost, HoldsTheVeryLinkAndNameAndBringsThemBack) {
    const ino_t link = inodeOf("etc/localtime");
    const ino_t name = inodeOf("etc/timezone");
    ASSERT_TRUE(changeOffset(root, 330));
    EXPECT_EQ(host.link(memory + "/localtime"), berlin);
    EXPECT_EQ(host.read(memory + "/timezone"), "Europe/Berlin\n");
    EXPECT_EQ(inodeOf(memory + "/localtime"), link);
    EXPECT_EQ(inodeOf(memory + "/timezone"), name);
    ASSERT_TRUE(changeDaylightSaving(root, true));
    EXPECT_EQ(inodeOf("etc/localtime"), link);
    EXPECT_EQ(inodeOf("etc/timezone"), name);
    EXPECT_THAT(root.list("/etc").names, ElementsAre("localtime", "timezone"));
}

TEST_F(ZoneMemoryOfHost, HoldsTheVeryFileWithItsRights) {
    const std::string bytes = host.read("usr/share/zoneinfo/Europe/Berlin");
    host.remove("etc/localtime");
    host.write("etc/localtime", bytes);
    ASSERT_EQ(chmod(host.path("etc/localtime").c_str(), 0640), 0);
    const ino_t file = inodeOf("etc/localtime");
    ASSERT_TRUE(changeOffset(root, 330));
    EXPECT_EQ(inodeOf(memory + "/localtime"), file);
    ASSERT_TRUE(changeDaylightSaving(root, true));
    EXPECT_EQ(inodeOf("etc/localtime"), file);
    EXPECT_EQ(host.read("etc/localtime"), bytes);
    struct stat status {};
    ASSERT_EQ(stat(host.path("etc/localtime").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0640U);
}

TEST_F(ZoneMemoryOfHost, SaysThatThereWasNoZone) {
    host.remove("etc/localtime");
    host.remove("etc/timezone");
    ASSERT_TRUE(changeOffset(root, 330));
    EXPECT_THAT(root.list("/" + memory).names, ElementsAre("no-localtime"));
    ASSERT_TRUE(changeDaylightSaving(root, true));
    EXPECT_THAT(root.list("/etc").names, ElementsAre());
    EXPECT_THAT(state(), ElementsAre("lock"));
}

TEST_F(ZoneMemoryOfHost, ThatIsDamagedCountsAsNoneAndIsKeptAside) {
    const std::vector<std::function<void()>> damages = {
        [this] { host.write(memory, "a file"); },
        [this] { std::filesystem::create_directories(host.path(memory)); },
        [this] { host.write(memory + "/localtime", ""); },
        [this] { host.write(memory + "/localtime", host.read("usr/share/zoneinfo/Europe/Berlin").substr(0, 300)); },
        [this] { std::filesystem::create_directories(host.path(memory + "/localtime")); },
    };
    std::string aside = "former-zone.damaged";
    for (std::size_t i = 0; i < damages.size(); ++i) {
        damages[i]();
        ASSERT_TRUE(changeOffset(root, 345)) << i;
        EXPECT_THAT(takeLog(), ElementsAre(AllOf(StartsWith("6000 "), HasSubstr("former-zone is damaged"),
                                                 HasSubstr("called " + aside)),
                                           StartsWith("3000 ")));
        EXPECT_EQ(host.link(memory + "/localtime"), berlin) << i;
        ASSERT_TRUE(changeDaylightSaving(root, true));
        EXPECT_EQ(host.link("etc/localtime"), berlin) << i;
        EXPECT_TRUE(host.exists("var/lib/vk/instrumentation/" + aside)) << i;
        aside = "former-zone.damaged-" + std::to_string(i + 2);
        takeLog();
    }
}

TEST_F(ZoneMemoryOfHost, ThatIsDamagedGivesWayToTheOneThatItWasToReplace) {
    host.link("/usr/share/zoneinfo/America/New_York", memory + ".old/localtime");
    host.write(memory + "/localtime", "");
    ASSERT_TRUE(changeOffset(root, 345)); // does not make Berlin the zone to come back to
    EXPECT_EQ(host.link(memory + "/localtime"), "/usr/share/zoneinfo/America/New_York");
    EXPECT_THAT(state(), ElementsAre("former-zone", "former-zone.damaged", "lock"));
}

TEST_F(ZoneMemoryOfHost, WhoseFirstHalfOfAChangeWasInterruptedGivesWayToo) {
    host.useZone("Asia/Kolkata");
    host.link("/usr/share/zoneinfo/America/New_York", memory + ".old/localtime");
    ASSERT_TRUE(changeDaylightSaving(root, true));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/America/New_York");
    EXPECT_THAT(state(), ElementsAre("lock"));
}

TEST_F(ZoneMemoryOfHost, OfAnOlderVersionThatIsDamagedCountsAsNoneAndIsKeptAside) {
    host.useZone("Europe/Berlin");
    const std::string damaged = "vk-zone 1\nlink 500\nshort\n";
    host.write("var/lib/vk/instrumentation/replaced-zone", damaged);
    ASSERT_TRUE(changeOffset(root, 345));
    EXPECT_THAT(takeLog(), ElementsAre(AllOf(StartsWith("6000 "), HasSubstr("replaced-zone is damaged"),
                                             HasSubstr("replaced-zone.damaged")),
                                       StartsWith("3000 ")));
    EXPECT_EQ(host.read("var/lib/vk/instrumentation/replaced-zone.damaged"), damaged);
    ASSERT_TRUE(changeDaylightSaving(root, true));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
}

TEST_F(ZoneMemoryOfHost, ThatIsDamagedBringsNothingBack) {
    host.useZone("Asia/Kolkata");
    host.write("var/lib/vk/instrumentation/replaced-zone", "");
    EXPECT_FALSE(changeDaylightSaving(root, true));
    EXPECT_THAT(takeLog(), ElementsAre(AllOf(StartsWith("6000 "), HasSubstr("replaced-zone is damaged"))));
    EXPECT_FALSE(changeDaylightSaving(root, true));
    EXPECT_THAT(takeLog(), ElementsAre(HasSubstr("no zone with daylight saving was replaced")));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Asia/Kolkata");
    EXPECT_TRUE(host.exists("var/lib/vk/instrumentation/replaced-zone.damaged"));
}

TEST_F(ZoneMemoryOfHost, OfAnOlderVersionComesBackOnce) {
    host.useZone("Asia/Kolkata");
    host.write("var/lib/vk/instrumentation/replaced-zone",
               "vk-zone 1\nlink 33\n/usr/share/zoneinfo/Europe/Berlin\nfile 14\nEurope/Berlin\n\n");
    ASSERT_TRUE(changeOffset(root, 60)); // does not make Kolkata the zone to come back to
    ASSERT_TRUE(changeDaylightSaving(root, true));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
    EXPECT_EQ(host.read("etc/timezone"), "Europe/Berlin\n");
    EXPECT_THAT(root.list("/var/lib/vk/instrumentation").names, ElementsAre("lock"));
    EXPECT_THAT(takeLog(), ElementsAre(StartsWith("3000 "), StartsWith("3000 ")));
}

TEST_F(ZoneMemoryOfHost, TakesTheFormOfThisVersion) {
    const std::string bytes = host.read("usr/share/zoneinfo/Europe/Berlin");
    host.useZone("Asia/Kolkata");
    host.write("var/lib/vk/instrumentation/replaced-zone",
               "vk-zone 1\nfile " + std::to_string(bytes.size()) + "\n" + bytes + "\nabsent 0\n\n");
    ASSERT_TRUE(changeOffset(root, 60));
    EXPECT_EQ(host.read(memory + "/localtime"), bytes);
    EXPECT_THAT(root.list("/" + memory).names, ElementsAre("localtime"));
    EXPECT_THAT(state(), ElementsAre("former-zone", "lock"));
}

TEST_F(ZoneMemoryOfHost, IsPreferredToThatOfAnOlderVersion) {
    ASSERT_TRUE(changeOffset(root, 330));
    host.write("var/lib/vk/instrumentation/replaced-zone",
               "vk-zone 1\nlink 32\n/usr/share/zoneinfo/Asia/Kolkata\nabsent 0\n\n");
    takeLog();
    ASSERT_TRUE(changeDaylightSaving(root, true));
    EXPECT_THAT(takeLog(),
                ElementsAre(HasSubstr("replaced-zone is not what was remembered last"), StartsWith("3000 ")));
    EXPECT_EQ(host.link("etc/localtime"), berlin);
    EXPECT_THAT(state(), ElementsAre("lock", "replaced-zone.damaged"));
}

TEST_F(ZoneMemoryOfHost, OfTheZoneInForceIsUsedUp) {
    ASSERT_TRUE(changeOffset(root, 330));
    host.useZone("Asia/Kolkata");
    host.remove(memory + "/localtime");
    host.link("/usr/share/zoneinfo/Asia/Kolkata", memory + "/localtime");
    takeLog();
    EXPECT_TRUE(changeDaylightSaving(root, true));
    EXPECT_THAT(takeLog(), ElementsAre()) << "nothing was changed";
    EXPECT_THAT(state(), ElementsAre("lock"));
}

TEST_F(ZoneMemoryOfHost, ThatCannotBeWrittenRefusesTheChange) {
    host.write("var/lib/vk/instrumentation/former-zone.vk-new/in/the way", "");
    EXPECT_FALSE(changeOffset(root, 345));
    EXPECT_THAT(takeLog(),
                ElementsAre(StartsWith("6000 offset from UTC not set to +345: /var/lib/vk/instrumentation")));
    EXPECT_EQ(host.link("etc/localtime"), berlin);
}

} // namespace

} // namespace VK::Zone
