#include "zone/ZoneChange.h"

#include "platform/zone/HostWithZones.h"
#include "zone/ZoneInForce.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

namespace VK::Zone {

namespace {

using support::HostCopy;
using support::takeLog;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

class ZoneChange : public HostWithZones {};

struct Offset {
    int minutes;
    const char* date; ///< what date says
    const char* link; ///< what /etc/localtime becomes; null for a file
    const char* name; ///< what /etc/timezone says
};

TEST_F(ZoneChange, EveryKindOfOffsetComesIntoForce) {
    use("Europe/Berlin");
    for (const Offset& each :
         {Offset{-300, "-0500", "../usr/share/zoneinfo/Etc/GMT+5", "Etc/GMT+5\n"},
          Offset{330, "+0530", nullptr, "<+0530>-5:30\n"}, Offset{345, "+0545", nullptr, "<+0545>-5:45\n"},
          Offset{0, "+0000", "../usr/share/zoneinfo/Etc/GMT", "Etc/GMT\n"},
          Offset{840, "+1400", "../usr/share/zoneinfo/Etc/GMT-14", "Etc/GMT-14\n"},
          Offset{-840, "-1400", nullptr, "<-14>14\n"}, Offset{-1, "-0001", nullptr, "<-0001>0:01\n"},
          Offset{60, "+0100", "../usr/share/zoneinfo/Etc/GMT-1", "Etc/GMT-1\n"}}) {
        ASSERT_TRUE(changeOffset(root(), each.minutes));
        EXPECT_EQ(offsetInForce(root()), each.minutes);
        EXPECT_FALSE(hasDaylightSaving(root()));
        EXPECT_EQ(host.date("2026-01-15"), each.date);
        EXPECT_EQ(host.date("2026-07-15"), each.date);
        EXPECT_EQ(host.link("etc/localtime"), each.link != nullptr ? each.link : "") << each.minutes;
        EXPECT_EQ(host.read("etc/timezone"), each.name);
        EXPECT_EQ(host.zdumpTransitions(), 0);
        EXPECT_EQ(takeLog().size(), 1U);
    }
}

TEST_F(ZoneChange, TheOffsetInForceIsAlreadySo) {
    use("Asia/Kolkata");
    EXPECT_TRUE(changeOffset(root(), 330));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Asia/Kolkata");
    EXPECT_FALSE(host.exists("var"));
    EXPECT_THAT(takeLog(), ElementsAre());
}

TEST_F(ZoneChange, OffsetsBeyondFourteenHoursAreRefused) {
    use("Europe/Berlin");
    for (const int minutes : {841, -841, 1440, 2147483647, -2147483647 - 1}) {
        EXPECT_FALSE(changeOffset(root(), minutes));
        EXPECT_THAT(takeLog(), ElementsAre(StartsWith("6000 offset from UTC of " + std::to_string(minutes))));
    }
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
    EXPECT_FALSE(host.exists("var"));
}

struct Daylight {
    const char* zone;
    const char* offDate;
    const char* offLink;
};

TEST_F(ZoneChange, DaylightSavingGoesOffAndComesBackAsItWas) {
    for (const Daylight& each : {Daylight{"Europe/Berlin", "+0100", "../usr/share/zoneinfo/Etc/GMT-1"},
                                 Daylight{"America/New_York", "-0500", "../usr/share/zoneinfo/Etc/GMT+5"},
                                 Daylight{"Australia/Adelaide", "+0930", ""}}) {
        use(each.zone);
        const std::string before = host.link("etc/localtime");
        ASSERT_TRUE(changeDaylightSaving(root(), false));
        EXPECT_FALSE(hasDaylightSaving(root()));
        EXPECT_EQ(host.link("etc/localtime"), each.offLink);
        EXPECT_EQ(host.date("2026-01-15"), each.offDate);
        EXPECT_EQ(host.date("2026-07-15"), each.offDate);
        EXPECT_EQ(host.zdumpTransitions(), 0);
        EXPECT_THAT(takeLog(),
                    ElementsAre(AllOf(StartsWith("3000 automatic daylight saving from 1 to 0"), HasSubstr(each.zone),
                                      HasSubstr("by uid " + std::to_string(getuid())))));

        ASSERT_TRUE(changeDaylightSaving(root(), true));
        EXPECT_TRUE(hasDaylightSaving(root()));
        EXPECT_EQ(host.link("etc/localtime"), before);
        EXPECT_EQ(host.read("etc/timezone"), std::string(each.zone) + "\n");
        EXPECT_GT(host.zdumpTransitions(), 0);
        EXPECT_THAT(takeLog(), ElementsAre(StartsWith("3000 automatic daylight saving from 0 to 1")));
    }
}

TEST_F(ZoneChange, ZonesWithoutDaylightSavingHaveItOffAndCannotGetIt) {
    for (const char* zone : {"Asia/Kolkata", "Etc/UTC"}) {
        use(zone);
        EXPECT_TRUE(changeDaylightSaving(root(), false));
        EXPECT_THAT(takeLog(), ElementsAre());
        EXPECT_FALSE(changeDaylightSaving(root(), true));
        EXPECT_THAT(takeLog(), ElementsAre(HasSubstr("no zone with daylight saving was replaced")));
        EXPECT_EQ(host.link("etc/localtime"), std::string("/usr/share/zoneinfo/") + zone);
        EXPECT_FALSE(host.exists("var"));
    }
}

TEST_F(ZoneChange, DaylightSavingThatIsOnStaysOn) {
    use("Europe/Berlin");
    EXPECT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_FALSE(host.exists("var"));
}

TEST_F(ZoneChange, AZoneFileComesBackByteForByte) {
    const std::string bytes = host.read("usr/share/zoneinfo/Europe/Berlin");
    host.remove("etc/localtime");
    host.write("etc/localtime", bytes);
    ASSERT_TRUE(changeDaylightSaving(root(), false));
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_EQ(host.link("etc/localtime"), "");
    EXPECT_EQ(host.read("etc/localtime"), bytes);
}

TEST_F(ZoneChange, SwitchingOnBringsBackTheZoneThatOffsetsReplaced) {
    use("America/New_York");
    ASSERT_TRUE(changeOffset(root(), 330));
    ASSERT_TRUE(changeOffset(root(), 60)); // does not make +0530 the zone to come back to
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/America/New_York");
    EXPECT_FALSE(changeOffset(root(), 5000));
    ASSERT_TRUE(changeDaylightSaving(root(), true)); // is on
}

TEST_F(ZoneChange, WithoutLocalTimeItIsUtcAndSoItComesBack) {
    host.remove("etc/localtime");
    EXPECT_EQ(offsetInForce(root()), 0);
    ASSERT_TRUE(changeOffset(root(), 60));
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_FALSE(host.exists("etc/localtime"));
}

TEST_F(ZoneChange, WithoutTimezoneFileNoneIsMade) {
    use("Europe/Berlin");
    host.remove("etc/timezone");
    ASSERT_TRUE(changeOffset(root(), 330));
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_FALSE(host.exists("etc/timezone"));
}

TEST_F(ZoneChange, ItsLineTellsWhatHappened) {
    use("Asia/Kolkata");
    ASSERT_TRUE(changeOffset(root(), 60));
    takeLog();
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_THAT(takeLog(), ElementsAre("3000 the zone replaced before is back, without daylight saving (Etc/GMT-1 "
                                       "became Asia/Kolkata) by uid " +
                                       std::to_string(getuid())));
}

TEST_F(ZoneChange, WithoutZoneDirectoryOffsetsAreFilesOfOurOwn) {
    host.remove("usr");
    host.remove("etc/localtime");
    ASSERT_TRUE(changeOffset(root(), 60));
    EXPECT_EQ(offsetInForce(root()), 60);
    EXPECT_EQ(host.link("etc/localtime"), "");
    EXPECT_EQ(host.date("2026-07-15"), "+0100");
}

TEST_F(ZoneChange, WithoutTheRightToItNothingChangesAndTheLogNamesIt) {
    if (geteuid() != 0) GTEST_SKIP() << "takes root, to become somebody else";
    use("Europe/Berlin");
    ASSERT_EQ(chmod(host.path().c_str(), 0755), 0);
    const auto asNobody = [&] {
        if (setgid(65534) != 0 || setuid(65534) != 0) _exit(10);
        if (changeOffset(root(), 345)) _exit(11);
        const std::vector<std::string> log = takeLog();
        if (log.size() != 1 || log[0].find("CAP_DAC_OVERRIDE") == std::string::npos) _exit(12);
        if (changeDaylightSaving(root(), false)) _exit(13);
        _exit(takeLog().size() == 1 ? 0 : 14);
    };
    EXPECT_EXIT(asNobody(), testing::ExitedWithCode(0), "");
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
}

TEST_F(ZoneChange, LeavesNothingBesideWhatItMeantToWrite) {
    use("Europe/Berlin");
    ASSERT_TRUE(changeOffset(root(), 330));
    ASSERT_TRUE(changeOffset(root(), 60));
    EXPECT_THAT(root().list("/etc").names, ElementsAre("localtime", "timezone"));
    EXPECT_THAT(root().list("/var/lib/vk/instrumentation").names, ElementsAre("former-zone", "lock"));
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_THAT(root().list("/var/lib/vk/instrumentation").names, ElementsAre("lock"));
}

TEST(ZoneInForce, HasTheNameThatItsLinkEndsWith) {
    EXPECT_EQ(zoneNameOf("/usr/share/zoneinfo/Europe/Berlin"), "Europe/Berlin");
    EXPECT_EQ(zoneNameOf("../usr/share/zoneinfo/UTC"), "UTC");
    EXPECT_EQ(zoneNameOf("/etc/somewhere"), "");
    EXPECT_EQ(zoneNameOf(""), "");
}

TEST(ZoneInForce, IsUtcUnlessTheFileCanBeTrusted) {
    HostCopy host;
    const auto offset = [&host] { return offsetInForce(Root(host.path())); };
    host.useZone("Asia/Kolkata");
    EXPECT_EQ(offset(), 330);
    host.remove("etc/localtime");
    EXPECT_EQ(offset(), 0);
    host.link("../usr/share/zoneinfo/No/Where", "etc/localtime"); // broken
    EXPECT_EQ(offset(), 0);
    host.remove("etc/localtime");
    host.write("var/zone", host.read("usr/share/zoneinfo/Asia/Kolkata"));
    host.link("/var/zone", "etc/localtime"); // neither here nor in the zone directory
    EXPECT_EQ(offset(), 0);
    host.remove("etc/localtime");
    host.write("etc/localtime", "text");
    EXPECT_EQ(offset(), 0);
    host.write("etc/localtime", host.read("usr/share/zoneinfo/Asia/Kolkata"));
    EXPECT_EQ(offset(), 330);
    host.remove("etc/localtime");
    host.link("../../../../../../usr/share/zoneinfo/Asia/Kolkata", "etc/localtime"); // inside the root all the same
    EXPECT_EQ(offset(), 330);
}

} // namespace

} // namespace VK::Zone
