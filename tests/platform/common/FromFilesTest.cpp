#include "common/FromFiles.h"

#include "support/HostCopy.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

namespace VK {

namespace {

class FromFilesTest : public testing::Test {
protected:
    FromFilesTest() { directory.write("etc/name", "one"); }

    std::string text() {
        return *made.get(root, [this](SeenFiles& files) {
            ++reads;
            files.add("/etc/name");
            const Root::Contents contents = root.read("/etc/name");
            return contents ? contents.text : "error " + std::to_string(contents.error);
        });
    }

    /// The text, read once since everything is older than the file system's clock is coarse.
    std::string settledText() {
        usleep(50'000);
        text();
        reads = 0;
        return text();
    }

    support::TemporaryDirectory directory;
    Root root{directory.path()};
    FromFiles<std::string> made;
    int reads = 0;
};

TEST_F(FromFilesTest, AreReadOnceWhileTheyStayTheSame) {
    EXPECT_EQ(settledText(), "one");
    EXPECT_EQ(text(), "one");
    EXPECT_EQ(reads, 0);
}

TEST_F(FromFilesTest, ShowEachChangeAtOnceAlsoInOneTickAndOfOneSize) {
    EXPECT_EQ(settledText(), "one");
    for (int i = 100; i < 300; ++i) {
        directory.write("etc/name", std::to_string(i));
        ASSERT_EQ(text(), std::to_string(i));
    }
}

TEST_F(FromFilesTest, ThatAreMissingShowWhenTheyAreMade) {
    std::filesystem::remove_all(directory.path("etc"));
    EXPECT_EQ(settledText(), "error 2");
    EXPECT_EQ(reads, 0);
    directory.write("etc/name", "two");
    EXPECT_EQ(text(), "two");
}

TEST_F(FromFilesTest, BehindLinksShowWhenALinkLeadsElsewhere) {
    directory.write("data/one", "one");
    directory.write("data/two", "two");
    std::filesystem::remove_all(directory.path("etc"));
    directory.link("/data", "current"); // absolute: below the root
    directory.link("../current/one", "etc/name");
    EXPECT_EQ(settledText(), "one");
    EXPECT_EQ(reads, 0);
    std::filesystem::remove(directory.path("etc/name"));
    directory.link("../current/two", "etc/name");
    EXPECT_EQ(text(), "two");

    EXPECT_EQ(settledText(), "two");
    directory.write("other/two", "three");
    std::filesystem::remove(directory.path("current"));
    directory.link("/other", "current");
    EXPECT_EQ(text(), "three");
}

TEST_F(FromFilesTest, BehindALinkThatLeadsNowhereShowWhenItsEndIsMade) {
    std::filesystem::remove_all(directory.path("etc"));
    directory.link("/data/one", "etc/name");
    EXPECT_EQ(settledText(), "error 2");
    EXPECT_EQ(reads, 0);
    directory.write("data/one", "one");
    EXPECT_EQ(text(), "one");
}

TEST_F(FromFilesTest, OfTheKernelAreReadEachTime) {
    Root host("/", true);
    FromFiles<int> values;
    int times = 0;
    for (int i = 0; i < 3; ++i)
        values.get(host, [&](SeenFiles& files) {
            files.add("/proc/uptime");
            return ++times;
        });
    EXPECT_EQ(times, 3);
}

TEST_F(FromFilesTest, StayAsTheyWereWhereDescriptorsRunOut) {
    EXPECT_EQ(settledText(), "one");
    directory.write("etc/name", "two");
    rlimit before{};
    ASSERT_EQ(getrlimit(RLIMIT_NOFILE, &before), 0);
    const rlimit none{0, before.rlim_max};
    ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &none), 0);
    const std::string starved = text();
    ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &before), 0);
    EXPECT_EQ(starved, "one");
    EXPECT_EQ(text(), "two");
}

TEST(BriefLock, GoesOnWithoutWhereAForkLeftItTaken) {
    std::atomic_flag busy = ATOMIC_FLAG_INIT;
    const BriefLock first(busy);
    EXPECT_TRUE(static_cast<bool>(first));
    EXPECT_FALSE(static_cast<bool>(BriefLock(busy)));
}

TEST(Kept, IsReadAgainWhereDescriptorsRanOutAndThenKept) {
    Kept<int> kept;
    int reads = 0;
    int announced = 0;
    const auto get = [&](int error) {
        return *kept.get(
            [&] {
                noteShortage(error);
                return ++reads;
            },
            [&](int) { ++announced; });
    };
    EXPECT_EQ(get(EMFILE), 1);
    EXPECT_EQ(get(ENFILE), 2);
    EXPECT_EQ(announced, 0);
    EXPECT_EQ(get(ENOENT), 3);
    EXPECT_EQ(get(EMFILE), 3);
    EXPECT_EQ(reads, 3);
    EXPECT_EQ(announced, 1);
}

} // namespace

} // namespace VK
