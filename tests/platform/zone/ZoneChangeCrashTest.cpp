#include "zone/ZoneChange.h"

#include "support/HostCopy.h"
#include "support/KilledRun.h"
#include "support/LogCapture.h"
#include "zone/ZoneInForce.h"

#include <gtest/gtest.h>

#include <functional>

namespace VK::Zone {

namespace {

using support::HostCopy;

/// Kills a change at each of its system calls, on a host that is made anew for each: `check` looks at what it left.
template <class Prepare, class Change, class Check>
void killEverywhere(const HostCopy& host, const Prepare& prepare, const Change& change, const Check& check) {
    int calls = 0;
    for (support::Outcome outcome = support::Killed; outcome == support::Killed && !testing::Test::HasFailure();
         ++calls) {
        SCOPED_TRACE("killed after " + std::to_string(calls) + " calls");
        host.remove("var");
        host.remove("etc");
        prepare();
        outcome = support::runKilledAt(change, calls);
        if (outcome == support::NotTraced) GTEST_SKIP() << "processes may not be traced here";
        check();
    }
    EXPECT_GT(calls, 40); // there were some to kill at
    support::takeLog();
}

/// The zone must be the old or the new one each time, and the host must be able to go on; then the zone before all
/// that comes back.
void expectOldOrNew(const char* zone, const std::function<void(const Root&)>& prepare,
                    const std::function<bool(const Root&)>& change, int oldOffset, int newOffset) {
    constexpr std::int64_t winter2026 = 1768435200;
    const support::InMemory<HostCopy> copy;
    const HostCopy& host = *copy;
    const Root root(host.path());
    const auto check = [&] {
        const auto found = zoneOfFile(root, "/etc/localtime");
        ASSERT_TRUE(found.has_value()) << "no zone";
        const int winter = found->at(winter2026).offset / 60;
        ASSERT_TRUE(winter == oldOffset || winter == newOffset) << winter;
        ASSERT_TRUE(change(root));
        ASSERT_EQ(zoneInForce(root).at(winter2026).offset / 60, newOffset);
        ASSERT_TRUE(changeDaylightSaving(root, true));
        ASSERT_EQ(host.link("etc/localtime"), std::string("/usr/share/zoneinfo/") + zone);
    };
    const auto start = [&] {
        host.useZone(zone);
        prepare(root);
    };
    killEverywhere(
        host, start, [&] { change(root); }, check);
}

TEST(ZoneChangeCrash, WhileTheOffsetIsChanged) {
    expectOldOrNew(
        "Europe/Berlin", [](const Root&) {}, [](const Root& root) { return changeOffset(root, 330); }, 60, 330);
}

TEST(ZoneChangeCrash, WhileDaylightSavingIsSwitchedOff) {
    expectOldOrNew(
        "Australia/Adelaide", [](const Root&) {}, [](const Root& root) { return changeDaylightSaving(root, false); },
        630, 570);
}

TEST(ZoneChangeCrash, WhileDaylightSavingIsSwitchedOn) {
    expectOldOrNew(
        "Australia/Adelaide", [](const Root& root) { changeDaylightSaving(root, false); },
        [](const Root& root) { return changeDaylightSaving(root, true); }, 570, 630);
}

/// A host with one zone remembered and another in force.
class ZoneMemoryCrash : public testing::Test {
protected:
    void prepare() {
        host.useZone("Europe/Berlin");
        changeOffset(root, -300);
        host.useZone("America/New_York");
    }
    bool switchOff() const { return changeDaylightSaving(root, false); }

    std::string remembered(const std::string& name = "former-zone") const {
        return host.link("var/lib/vk/instrumentation/" + name + "/localtime");
    }

    const std::string berlin = "/usr/share/zoneinfo/Europe/Berlin";
    const std::string newYork = "/usr/share/zoneinfo/America/New_York";
    const support::InMemory<HostCopy> copy;
    const HostCopy& host = *copy;
    const Root root{host.path()};
};

TEST_F(ZoneMemoryCrash, KeepsWhatWasRememberedUntilAnotherZoneIsInForce) {
    const auto check = [this] {
        const bool isOld = host.link("etc/localtime") == newYork;
        ASSERT_TRUE(isOld ? remembered() == berlin || remembered("former-zone.old") == berlin
                          : remembered() == newYork);
        ASSERT_TRUE(switchOff());
        ASSERT_EQ(host.link("etc/localtime"), "../usr/share/zoneinfo/Etc/GMT+5");
        ASSERT_EQ(remembered(), newYork);
        ASSERT_EQ(host.read("var/lib/vk/instrumentation/former-zone/timezone"), "America/New_York\n");
        ASSERT_TRUE(changeDaylightSaving(root, true));
        ASSERT_EQ(host.link("etc/localtime"), newYork);
        ASSERT_EQ(root.list("/var/lib/vk/instrumentation").names, std::vector<std::string>{"lock"});
    };
    killEverywhere(
        host, [this] { prepare(); }, [this] { switchOff(); }, check);
}

TEST_F(ZoneMemoryCrash, KeepsWhatWasRememberedWhenTheChangeIsRefused) {
    const auto start = [this] {
        prepare();
        host.write("etc/.localtime.vk-new/busy", ""); // in the way of what is written beside /etc/localtime
    };
    const auto check = [this] {
        ASSERT_EQ(host.link("etc/localtime"), newYork);
        ASSERT_FALSE(switchOff());
        ASSERT_EQ(host.link("etc/localtime"), newYork);
        ASSERT_EQ(remembered(), berlin);
    };
    killEverywhere(
        host, start, [this] { switchOff(); }, check);
}

TEST_F(ZoneMemoryCrash, KeepsWhatAnOlderVersionRemembered) {
    const auto start = [this] {
        host.useZone("Asia/Kolkata");
        host.write("var/lib/vk/instrumentation/replaced-zone",
                   "vk-zone 1\nlink 33\n/usr/share/zoneinfo/Europe/Berlin\nfile 14\nEurope/Berlin\n\n");
    };
    const auto check = [this] {
        ASSERT_TRUE(changeDaylightSaving(root, true));
        ASSERT_EQ(host.link("etc/localtime"), berlin);
    };
    killEverywhere(
        host, start, [this] { changeDaylightSaving(root, true); }, check);
    EXPECT_FALSE(host.exists("var/lib/vk/instrumentation/replaced-zone.damaged"));
}

} // namespace

} // namespace VK::Zone
