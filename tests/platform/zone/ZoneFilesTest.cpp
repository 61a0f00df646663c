#include "common/FileLock.h"
#include "platform/zone/HostWithZones.h"
#include "zone/ZoneChange.h"
#include "zone/ZoneInForce.h"

#include <gmock/gmock.h>

#include <atomic>
#include <chrono>
#include <cstdio>
#include <fcntl.h>
#include <filesystem>
#include <functional>
#include <future>
#include <memory>
#include <thread>
#include <unistd.h>

namespace VK::Zone {

namespace {

using support::HostCopy;
using support::takeLog;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

class ZoneFilesOfHost : public HostWithZones {};

TEST_F(ZoneFilesOfHost, ThatCannotBeWrittenLeaveTheZoneRememberedBefore) {
    use("Europe/Berlin");
    ASSERT_TRUE(changeOffset(root(), 330));
    use("America/New_York");
    host.write("etc/.localtime.vk-new/busy", ""); // in the way of what is written beside /etc/localtime
    takeLog();
    EXPECT_FALSE(changeDaylightSaving(root(), false));
    EXPECT_THAT(takeLog(), ElementsAre(HasSubstr("/etc/localtime: Is a directory")));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/America/New_York");
    host.remove("etc/.localtime.vk-new");
    use("Asia/Kolkata");
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
}

TEST_F(ZoneFilesOfHost, BelowALinkAreLinkedByTheirWholePath) {
    host.remove("etc");
    std::filesystem::create_directories(host.path("data/host/etc"));
    host.link("data/host/etc", "etc");
    use("Europe/Berlin");
    ASSERT_TRUE(changeOffset(root(), -300));
    EXPECT_EQ(offsetInForce(root()), -300);
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Etc/GMT+5");
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
}

TEST_F(ZoneFilesOfHost, OfAZoneThatIsGoneDoNotComeBack) {
    use("Europe/Berlin");
    ASSERT_TRUE(changeOffset(root(), -300));
    host.remove("usr/share/zoneinfo/Europe");
    takeLog();
    EXPECT_FALSE(changeDaylightSaving(root(), true));
    EXPECT_THAT(takeLog(), ElementsAre(AllOf(StartsWith("6000 "), HasSubstr("Europe/Berlin"))));
    EXPECT_EQ(host.link("etc/localtime"), "../usr/share/zoneinfo/Etc/GMT+5");
    std::filesystem::create_directories(host.path("usr/share/zoneinfo/Europe"));
    std::filesystem::copy("/usr/share/zoneinfo/Europe/Berlin", host.path("usr/share/zoneinfo/Europe/Berlin"));
    EXPECT_TRUE(changeDaylightSaving(root(), true)) << "it is still remembered";
}

/// Puts another zone into force, again and again, as fast as it goes.
class Meddler {
public:
    explicit Meddler(const HostCopy& host)
        : thread([&host, this] {
              while (!ended) {
                  symlink("/usr/share/zoneinfo/Asia/Kolkata", host.path("etc/other").c_str());
                  std::rename(host.path("etc/other").c_str(), host.path("etc/localtime").c_str());
              }
          }) {}
    ~Meddler() {
        ended = true;
        thread.join();
    }
    Meddler(const Meddler&) = delete;
    Meddler& operator=(const Meddler&) = delete;

private:
    std::atomic<bool> ended{false};
    std::thread thread;
};

TEST_F(ZoneFilesOfHost, ThatDidNotComeIntoForceAreNoChange) {
    use("Asia/Kolkata");
    bool refused = false;
    {
        const Meddler meddler(host);
        for (int i = 0; i < 10'000 && !refused; ++i) {
            takeLog();
            refused = !changeOffset(root(), 60);
        }
    }
    ASSERT_TRUE(refused);
    EXPECT_THAT(takeLog(), ElementsAre(AllOf(StartsWith("6000 "), HasSubstr("another zone was put into force"))));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Asia/Kolkata");
}

TEST_F(ZoneFilesOfHost, SwitchedOffByTwoAtOnceStillComeBack) {
    use("Europe/Berlin");
    const std::string state = host.path() + "/var/lib/vk/instrumentation";
    std::filesystem::create_directories(state);
    auto lock = std::make_unique<FileLock>(AT_FDCWD, state + "/lock");
    ASSERT_EQ(lock->error(), 0);
    const auto switchOff = [this] { return changeDaylightSaving(root(), false); };
    auto first = std::async(std::launch::async, switchOff);
    auto second = std::async(std::launch::async, switchOff);
    std::this_thread::sleep_for(std::chrono::milliseconds(300)); // both have found it on, and wait
    lock.reset();
    EXPECT_TRUE(first.get());
    EXPECT_TRUE(second.get());
    EXPECT_EQ(takeLog().size(), 1U);
    EXPECT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_EQ(host.link("etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin");
}

/// Puts a zone into force while a change waits for the lock, and then lets it go on.
void whileWaiting(const HostCopy& host, const std::string& zone, const std::function<bool(const Root&)>& change) {
    const std::string state = host.path() + "/var/lib/vk/instrumentation";
    std::filesystem::create_directories(state);
    auto lock = std::make_unique<FileLock>(AT_FDCWD, state + "/lock");
    auto changed = std::async(std::launch::async, [&] { return change(Root(host.path())); });
    std::this_thread::sleep_for(std::chrono::milliseconds(300)); // it has looked at the zone, and waits
    host.useZone(zone);
    lock.reset();
    EXPECT_TRUE(changed.get());
}

TEST_F(ZoneFilesOfHost, StartFromTheZoneThatIsInForceWhenTheirTurnComes) {
    use("Etc/UTC");
    whileWaiting(host, "Asia/Kolkata", [](const Root& where) { return changeOffset(where, 60); });
    EXPECT_THAT(takeLog(), ElementsAre(HasSubstr("offset from UTC from +330 to +060")));
    use("Europe/Berlin");
    whileWaiting(host, "America/New_York", [](const Root& where) { return changeDaylightSaving(where, false); });
    EXPECT_EQ(host.link("etc/localtime"), "../usr/share/zoneinfo/Etc/GMT+5");
}

TEST_F(ZoneFilesOfHost, OfANameThatCannotBeReadAreChangedAllTheSame) {
    use("Europe/Berlin");
    host.remove("etc/timezone");
    host.write("etc/timezone/note", "a directory");
    ASSERT_TRUE(changeOffset(root(), 330));
    EXPECT_THAT(takeLog(),
                ElementsAre(HasSubstr("6000 /etc/timezone does not follow: Is a directory"), StartsWith("3000 ")));
    ASSERT_TRUE(changeDaylightSaving(root(), true));
    EXPECT_EQ(host.read("etc/timezone/note"), "a directory");

    host.remove("etc/timezone");
    const std::string large(2 << 20, 'x');
    host.write("etc/timezone", large);
    takeLog();
    ASSERT_TRUE(changeOffset(root(), 330));
    EXPECT_THAT(takeLog(),
                ElementsAre(HasSubstr("6000 /etc/timezone does not follow: File too large"), StartsWith("3000 ")));
    EXPECT_EQ(host.read("etc/timezone"), large);
}

} // namespace

} // namespace VK::Zone
