#include "vk/Moniker.h"

#include <gtest/gtest.h>

using VK::Moniker;

namespace {

/// The current pair as `name=value`, or `-`.
std::string current(const Moniker& moniker) {
    std::string name = "-";
    std::string value;
    const bool hasName = moniker.getName(name);
    EXPECT_EQ(moniker.getValue(value), hasName);
    return hasName ? name + "=" + value : name + value;
}

} // namespace

TEST(Moniker, IsEmptyAtFirst) {
    Moniker moniker;
    EXPECT_EQ(moniker.getKeyCount(), 0U);
    EXPECT_EQ(current(moniker), "-");
    EXPECT_FALSE(moniker.selectKey(0));
}

TEST(Moniker, KeepsPairsInOrder) {
    Moniker moniker;
    moniker.addKey("Name", "node7");
    moniker.addKey("CreationClassName", "VESKA_ComputerSystem");
    EXPECT_EQ(moniker.getKeyCount(), 2U);
    EXPECT_EQ(current(moniker), "Name=node7");
    EXPECT_TRUE(moniker.selectKey(1));
    EXPECT_EQ(current(moniker), "CreationClassName=VESKA_ComputerSystem");
    EXPECT_TRUE(moniker.selectKey(0));
    EXPECT_EQ(current(moniker), "Name=node7");
}

TEST(Moniker, KeepsTheSameNameTwice) {
    Moniker moniker;
    moniker.addKey("Name", "a");
    moniker.addKey("Name", "b");
    EXPECT_EQ(moniker.getKeyCount(), 2U);
    moniker.selectKey(1);
    EXPECT_EQ(current(moniker), "Name=b");
}

TEST(Moniker, StandsOnNoPairBeyondTheEnd) {
    Moniker moniker;
    moniker.addKey("Name", "node7");
    EXPECT_FALSE(moniker.selectKey(1));
    EXPECT_EQ(current(moniker), "-");
    moniker.addKey("Tag", "1");
    EXPECT_EQ(current(moniker), "-");
    EXPECT_FALSE(moniker.selectKey(4294967295U));
    EXPECT_TRUE(moniker.selectKey(1));
    EXPECT_EQ(current(moniker), "Tag=1");
}

TEST(Moniker, ThatIsEmptyStandsOnItsFirstPairOnceThatComesUnlessASelectionFailed) {
    Moniker untouched;
    untouched.addKey("Name", "node7");
    EXPECT_EQ(current(untouched), "Name=node7");

    Moniker selected;
    EXPECT_FALSE(selected.selectKey(0));
    selected.addKey("Name", "node7");
    EXPECT_EQ(current(selected), "-");
    EXPECT_TRUE(selected.selectKey(0));
    EXPECT_EQ(current(selected), "Name=node7");
}

TEST(Moniker, CopiesPairsAndCursor) {
    Moniker moniker;
    moniker.addKey("Name", "a");
    moniker.addKey("Tag", "b");
    moniker.selectKey(1);
    const Moniker copy(moniker);
    Moniker assigned;
    assigned = moniker;
    moniker.addKey("More", "c");
    moniker.selectKey(2);
    EXPECT_EQ(copy.getKeyCount(), 2U);
    EXPECT_EQ(current(copy), "Tag=b");
    EXPECT_EQ(current(assigned), "Tag=b");
}
