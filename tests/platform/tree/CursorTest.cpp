#include "tree/Cursor.h"

#include "support/TemporaryDirectory.h"
#include "tree/SimulatedHost.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace VK::Tree {

namespace {

using testing::ElementsAre;

class CursorTest : public testing::Test {
protected:
    CursorTest() {
        directory.write("tree.json", R"({"nodes":[
            {"type":40,"path":"/a","status":1,"properties":{"108":"one"}},
            {"type":1,"path":"/a/x","parent":"/a","status":20},
            {"type":40,"path":"/b","properties":{"108":"two"}},
            {"type":1,"path":"/b/x","parent":"/b"},
            {"type":40,"path":"/c"}]})");
    }

    std::string path() const { return cursor.node() != nullptr ? cursor.node()->path : "nothing"; }

    std::vector<std::string> rest() {
        std::vector<std::string> paths;
        for (; cursor.node() != nullptr; cursor.advance()) paths.push_back(cursor.node()->path);
        return paths;
    }

    support::TemporaryDirectory directory;
    SimulatedHost host{directory.path("tree.json")};
    Cursor cursor{host};
};

TEST_F(CursorTest, StandsOnNothingAtFirstAndStaysThere) {
    cursor.advance();
    cursor.filterByPath("/a");
    EXPECT_EQ(path(), "nothing");
    EXPECT_EQ(cursor.status(), 0U);
    EXPECT_FALSE(cursor.read(108).has_value());
    EXPECT_FALSE(cursor.isReadOnly(108).has_value());
    EXPECT_FALSE(cursor.write(108, Value("x")));
}

TEST_F(CursorTest, WalksTheNodesOfOneTypeInFileOrder) {
    cursor.selectType(40);
    EXPECT_EQ(cursor.status(), 1U);
    EXPECT_THAT(rest(), ElementsAre("/a", "/b", "/c"));
    cursor.advance();
    EXPECT_EQ(path(), "nothing");
    cursor.selectType(1);
    EXPECT_THAT(rest(), ElementsAre("/a/x", "/b/x"));
    cursor.selectType(7);
    EXPECT_THAT(rest(), ElementsAre());
}

TEST_F(CursorTest, StandsOnOnePathAndThenOnNothing) {
    cursor.selectPath("/b");
    EXPECT_THAT(rest(), ElementsAre("/b"));
    cursor.selectPath("");
    EXPECT_EQ(path(), "nothing");
    cursor.selectPath("/d");
    EXPECT_EQ(path(), "nothing");
}

TEST_F(CursorTest, AFilterMovesOnToItsNodeAndNeverBack) {
    cursor.selectType(40);
    cursor.filterByPath("/b");
    EXPECT_THAT(rest(), ElementsAre("/b"));

    cursor.selectType(40);
    cursor.advance();
    cursor.filterByPath("/a");
    EXPECT_EQ(path(), "nothing");

    cursor.selectType(40);
    cursor.filterByPath("/a/x"); // of another type
    EXPECT_EQ(path(), "nothing");

    cursor.selectPath("/a");
    cursor.filterByPath("/b");
    EXPECT_EQ(path(), "nothing");
}

TEST_F(CursorTest, SelectingDropsTheFilter) {
    cursor.selectType(40);
    cursor.filterByPath("/a");
    cursor.selectType(40);
    EXPECT_THAT(rest(), ElementsAre("/a", "/b", "/c"));
}

TEST_F(CursorTest, SeesWhatItWroteAndGoesOnFromThere) {
    cursor.selectType(40);
    cursor.advance();
    ASSERT_TRUE(cursor.write(108, Value("new")));
    EXPECT_EQ(cursor.read(108), Value("new"));
    EXPECT_THAT(rest(), ElementsAre("/b", "/c"));
}

/// Returns another status at each look, and another name of a node whose name is not in the file.
class AgeingHost : public NodeSource {
public:
    explicit AgeingHost(SimulatedHost& theNodes) : nodes(theNodes) {}
    std::shared_ptr<const NodeTree> tree() override { return nodes.tree(); }
    std::optional<Value> read(const Node&, unsigned int) override { return Value("name " + std::to_string(++looks)); }
    bool write(const Node&, unsigned int, const Value&) override { return true; }
    std::optional<bool> isReadOnly(const Node&, unsigned int) override { return std::nullopt; }
    unsigned int status(const Node&) override { return ++looks; }

private:
    SimulatedHost& nodes;
    unsigned int looks = 0;
};

TEST_F(CursorTest, LooksAtAChangingNameOnceUntilItMovesOrWritesAndAtAllElseEachTime) {
    AgeingHost ageing(host);
    Cursor place(ageing);
    place.selectPath("/c");
    EXPECT_EQ(place.read(108), Value("name 1"));
    EXPECT_EQ(place.read(108), Value("name 1"));
    EXPECT_EQ(place.read(126), Value("name 2"));
    EXPECT_EQ(place.read(126), Value("name 3"));
    EXPECT_TRUE(place.write(108, Value("other")));
    EXPECT_EQ(place.read(108), Value("name 4"));
    place.selectPath("/c");
    EXPECT_EQ(place.read(108), Value("name 5"));
}

TEST_F(CursorTest, LooksAtTheStatusOnceUntilItMovesOrWrites) {
    AgeingHost ageing(host);
    Cursor place(ageing);
    place.selectType(40);
    EXPECT_EQ(place.status(), 1U);
    EXPECT_EQ(place.status(), 1U);
    place.advance();
    EXPECT_EQ(place.status(), 2U);
    EXPECT_TRUE(place.write(108, Value("other")));
    EXPECT_EQ(place.status(), 3U);
    place.filterByPath("/b");
    EXPECT_EQ(place.status(), 4U);
    place.selectPath("/a");
    EXPECT_EQ(place.status(), 5U);
    place.finish();
    EXPECT_EQ(place.status(), 0U);
}

} // namespace

} // namespace VK::Tree
