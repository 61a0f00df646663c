#include "tools/snapshot/Target.h"

#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

namespace fs = std::filesystem;
using support::TemporaryDirectory;
using testing::HasSubstr;
using testing::ThrowsMessage;

namespace snapshot {

namespace {

class TargetTest : public testing::Test {
protected:
    TemporaryDirectory parent;
    TemporaryDirectory elsewhere;
    fs::path place = parent.path("copy");
};

} // namespace

TEST_F(TargetTest, FollowsNothingThatOthersPutIntoItMeanwhile) {
    for (const char* name : {"etc/hostname", "proc/sys/kernel/arch", "file"}) {
        Target target(place);
        fs::create_symlink(elsewhere.path(), place / *fs::path(name).begin());
        const auto refuses = ThrowsMessage<Failure>(HasSubstr((place / name).string() + ": File exists"));
        EXPECT_THAT([&] { target.write(name, "secret"); }, refuses);
        EXPECT_THAT([&] { target.link(name, "secret"); }, refuses);
        EXPECT_TRUE(fs::is_empty(elsewhere.path()));
        fs::remove_all(place);
    }
}

TEST_F(TargetTest, TakesNoDirectoryForItsOwnThatItDidNotMake) {
    Target target(place);
    fs::create_directory(place / "etc");
    EXPECT_THROW(target.write("etc/hostname", "secret"), Failure);
    EXPECT_TRUE(fs::is_empty(place / "etc"));
}

TEST_F(TargetTest, TakesAwayAllThatItMade) {
    Target target(place / "below");
    target.write("etc/hostname", "node7");
    target.write("etc-2/x", "");
    target.link("etc/localtime", "/usr/share/zoneinfo/UTC");
    EXPECT_EQ(fs::read_symlink(place / "below/etc/localtime"), "/usr/share/zoneinfo/UTC");
    EXPECT_TRUE(target.remove());
    EXPECT_FALSE(fs::exists(place));
}

TEST_F(TargetTest, TakesAwayItsOwnBelowADirectoryThatOthersUse) {
    fs::create_directory(place);
    fs::permissions(place, fs::perms::all);
    Target target(place);
    EXPECT_EQ(target.getPath().parent_path(), place);
    target.write("etc/hostname", "node7");
    EXPECT_TRUE(fs::exists(target.getPath() / "etc/hostname"));
    EXPECT_TRUE(target.remove());
    EXPECT_TRUE(fs::is_empty(place));
}

TEST_F(TargetTest, SaysThatSomethingStaysOfIt) {
    Target target(place);
    target.write("etc/hostname", "node7");
    parent.write("copy/etc/other", "");
    EXPECT_FALSE(target.remove());
    EXPECT_FALSE(fs::exists(place / "etc/hostname"));
    EXPECT_TRUE(fs::exists(place / "etc/other"));
}

} // namespace snapshot
