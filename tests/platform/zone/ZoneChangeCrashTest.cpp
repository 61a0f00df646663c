#include "zone/ZoneChange.h"

#include "support/LogCapture.h"
#include "zone/ZoneInForce.h"
#include "support/HostCopy.h"
#include "support/KilledRun.h"

#include <gtest/gtest.h>

#include <functional>

namespace VK::Zone {

namespace {

using support::HostCopy;

/// Kills a change at each of its system calls; the zone must be the old or the new one each time, and the host must be
/// able to go on.
void killEverywhere(const char* zone, const std::function<void(const Root&)>& prepare,
                    const std::function<bool(const Root&)>& change, int oldOffset, int newOffset) {
    constexpr std::int64_t WINTER_2026 = 1768435200;
    const support::InMemory<HostCopy> copy;
    const HostCopy& host = *copy;
    const Root root(host.path());
    int calls = 0;
    for (support::Outcome outcome = support::Killed; outcome == support::Killed; ++calls) {
        host.remove("var");
        host.remove("etc");
        host.useZone(zone);
        prepare(root);
        outcome = support::runKilledAt([&] { change(root); }, calls);
        if (outcome == support::NotTraced) GTEST_SKIP() << "processes may not be traced here";
        const auto found = zoneOfFile(root, "/etc/localtime");
        ASSERT_TRUE(found.has_value()) << "no zone after " << calls << " calls";
        const int winter = found->at(WINTER_2026).offset / 60;
        ASSERT_TRUE(winter == oldOffset || winter == newOffset) << winter << " after " << calls << " calls";
        ASSERT_TRUE(change(root)) << "after " << calls << " calls";
        ASSERT_EQ(zoneInForce(root).at(WINTER_2026).offset / 60, newOffset);
    }
    EXPECT_GT(calls, 40); // there were some to kill at
    support::takeLog();
}

TEST(ZoneChangeCrash, WhileTheOffsetIsChanged) {
    killEverywhere(
        "Europe/Berlin", [](const Root&) {}, [](const Root& root) { return changeOffset(root, 330); }, 60, 330);
}

TEST(ZoneChangeCrash, WhileDaylightSavingIsSwitchedOff) {
    killEverywhere(
        "Australia/Adelaide", [](const Root&) {}, [](const Root& root) { return changeDaylightSaving(root, false); },
        630, 570);
}

TEST(ZoneChangeCrash, WhileDaylightSavingIsSwitchedOn) {
    killEverywhere(
        "Australia/Adelaide", [](const Root& root) { changeDaylightSaving(root, false); },
        [](const Root& root) { return changeDaylightSaving(root, true); }, 570, 630);
}

} // namespace

} // namespace VK::Zone
