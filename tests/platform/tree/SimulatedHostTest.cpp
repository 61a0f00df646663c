#include "tree/SimulatedHost.h"

#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>
#include <utime.h>

namespace VK::Tree {

namespace {

using testing::HasSubstr;

constexpr const char* treeText = R"({"nodes":[{"type":40,"path":"/c","properties":{"108":"node7","127":60},
    "readOnly":[108],"unanswerable":[9],"failWrites":[126]}]})";

class SimulatedHostTest : public testing::Test {
protected:
    SimulatedHostTest() { directory.write("tree.json", treeText); }

    std::string file() const { return directory.path("tree.json"); }

    support::TemporaryDirectory directory;
    SimulatedHost host{file()};
};

std::optional<Value> readFrom(SimulatedHost& host, const std::string& path, unsigned int property) {
    const auto tree = host.tree();
    const NodeTree::Place place = tree->find(path);
    return place.node != nullptr ? host.read(*place.node, property) : std::nullopt;
}

TEST_F(SimulatedHostTest, AnswersWhetherPropertiesAreReadOnly) {
    const auto tree = host.tree();
    const Node& node = *tree->find("/c").node;
    EXPECT_EQ(host.isReadOnly(node, 108), true);
    EXPECT_EQ(host.isReadOnly(node, 127), false);
    EXPECT_EQ(host.isReadOnly(node, 4711), false);
    EXPECT_EQ(host.isReadOnly(node, 9), std::nullopt);
}

TEST_F(SimulatedHostTest, WritesWhatMayBeWrittenAndNothingElse) {
    const auto tree = host.tree();
    const Node& node = *tree->find("/c").node;
    EXPECT_FALSE(host.write(node, 108, Value("x")));     // read-only
    EXPECT_FALSE(host.write(node, 126, Value("x")));     // fails
    EXPECT_FALSE(host.write(node, 127, Value("sixty"))); // a number
    EXPECT_EQ(directory.read("tree.json"), treeText);
    EXPECT_TRUE(host.write(node, 127, Value(4294966996U)));
    EXPECT_TRUE(host.write(node, 200, Value(1U)));           // new
    EXPECT_TRUE(host.write(node, 9, Value("unanswerable"))); // but writable
    EXPECT_EQ(readFrom(host, "/c", 127), Value(4294966996U));
    EXPECT_EQ(readFrom(host, "/c", 200), Value(1U));
    EXPECT_EQ(readFrom(host, "/c", 9), Value("unanswerable"));
    EXPECT_EQ(readFrom(host, "/c", 108), Value("node7"));
}

TEST_F(SimulatedHostTest, ParsesAnUnchangedFileOnce) {
    usleep(50'000); // until the file's stamp shows every change
    host.tree();
    const auto first = host.tree();
    EXPECT_EQ(host.tree(), first);
    directory.write("tree.json", treeText);
    EXPECT_NE(host.tree(), first);
}

TEST_F(SimulatedHostTest, SeesTwoChangesInTheSameTick) {
    for (unsigned int i = 0; i < 200; ++i) {
        // Always the same size and the same inode.
        directory.write("tree.json",
                        R"({"nodes":[{"type":40,"path":"/c","properties":{"1":)" + std::to_string(1000 + i) + "}}]}");
        ASSERT_EQ(readFrom(host, "/c", 1), Value(1000 + i));
    }
}

TEST_F(SimulatedHostTest, LeavesModeAndLinkAsTheyWere) {
    ASSERT_EQ(chmod(file().c_str(), 0640), 0);
    directory.link("tree.json", "link.json");
    SimulatedHost linked(directory.path("link.json"));
    ASSERT_TRUE(linked.write(*linked.tree()->find("/c").node, 127, Value(0U)));

    struct stat status {};
    ASSERT_EQ(lstat(directory.path("link.json").c_str(), &status), 0);
    EXPECT_TRUE(S_ISLNK(status.st_mode));
    ASSERT_EQ(stat(file().c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0640U);
    EXPECT_EQ(readFrom(host, "/c", 127), Value(0U));
}

TEST_F(SimulatedHostTest, TwoWritersLoseNothing) {
    const auto writer = [this](unsigned int first) {
        SimulatedHost own(file());
        for (unsigned int i = first; i < first + 30; ++i)
            ASSERT_TRUE(own.write(*own.tree()->find("/c").node, i, Value(i)));
    };
    std::thread one(writer, 1000), two(writer, 2000);
    one.join();
    two.join();
    for (unsigned int i = 0; i < 30; ++i) {
        EXPECT_EQ(readFrom(host, "/c", 1000 + i), Value(1000 + i));
        EXPECT_EQ(readFrom(host, "/c", 2000 + i), Value(2000 + i));
    }
}

TEST_F(SimulatedHostTest, ReadersFindAWholeFileWhileItIsWritten) {
    std::atomic<bool> stop{false};
    std::thread reader([&] {
        SimulatedHost own(file());
        while (!stop) EXPECT_NE(own.tree()->find("/c").node, nullptr) << own.state()->problem;
    });
    for (unsigned int i = 0; i < 50; ++i) EXPECT_TRUE(host.write(*host.tree()->find("/c").node, 127, Value(i)));
    stop = true;
    reader.join();
}

TEST_F(SimulatedHostTest, AWriterThatOverwritesNothingOfAnotherNodesChanges) {
    SimulatedHost other(file());
    const auto before = host.tree();
    ASSERT_TRUE(other.write(*other.tree()->find("/c").node, 64, Value("uuid")));
    ASSERT_TRUE(host.write(*before->find("/c").node, 127, Value(1U))); // with a tree from before
    EXPECT_EQ(readFrom(host, "/c", 64), Value("uuid"));
}

TEST_F(SimulatedHostTest, RefusesToWriteToANodeThatIsGone) {
    const auto before = host.tree();
    directory.write("tree.json", R"({"nodes":[]})");
    EXPECT_FALSE(host.write(*before->find("/c").node, 127, Value(1U)));
    EXPECT_EQ(directory.read("tree.json"), R"({"nodes":[]})");
}

TEST_F(SimulatedHostTest, AFileThatCannotBeUsedIsAnEmptyTree) {
    const auto problemOf = [](const std::string& name) {
        SimulatedHost broken(name);
        EXPECT_TRUE(broken.tree()->isEmpty());
        return broken.state()->problem;
    };
    EXPECT_EQ(problemOf(directory.path("missing.json")), "No such file or directory");
    EXPECT_EQ(problemOf(directory.path()), "not a regular file");
    ASSERT_EQ(mkfifo(directory.path("pipe").c_str(), 0600), 0);
    EXPECT_EQ(problemOf(directory.path("pipe")), "not a regular file");
    directory.write("broken.json", "{\"nodes\":");
    EXPECT_THAT(problemOf(directory.path("broken.json")), HasSubstr("not JSON at byte 10"));
    directory.write("secret.json", treeText);
    ASSERT_EQ(chmod(directory.path("secret.json").c_str(), 0), 0);
    if (geteuid() != 0) { // root sees all
        EXPECT_EQ(problemOf(directory.path("secret.json")), "Permission denied");
    }
}

TEST_F(SimulatedHostTest, RefusesAHundredMegabytesUnread) {
    directory.write("large.json", "");
    ASSERT_EQ(truncate(directory.path("large.json").c_str(), 100'000'000), 0);
    SimulatedHost large(directory.path("large.json"));
    EXPECT_TRUE(large.tree()->isEmpty());
    EXPECT_EQ(large.state()->problem, "larger than 16777216 bytes");
}

TEST_F(SimulatedHostTest, AMendedFileIsReadAgain) {
    directory.write("tree.json", "{");
    EXPECT_TRUE(host.tree()->isEmpty());
    directory.write("tree.json", treeText);
    EXPECT_FALSE(host.tree()->isEmpty());
    ASSERT_EQ(unlink(file().c_str()), 0);
    EXPECT_TRUE(host.tree()->isEmpty());
    directory.write("tree.json", treeText);
    EXPECT_FALSE(host.tree()->isEmpty());
}

} // namespace

} // namespace VK::Tree
