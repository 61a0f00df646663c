#include "tree/TreeFile.h"

#include "support/InChild.h"
#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <sys/resource.h>

namespace VK::Tree {

namespace {

TreeChange changeTo(const std::string& text) {
    return [=](const std::string&, std::string&) { return text; };
}

/// The longest text that fits, and one that is a byte longer.
TEST(TreeFile, TakesNoTextThatIsLongerThanTheLimit) {
    const support::TemporaryDirectory directory;
    directory.write("tree.json", "old");
    EXPECT_EQ(replaceTreeFile(directory.path("tree.json"), 4, changeTo("four")), "");
    EXPECT_EQ(replaceTreeFile(directory.path("tree.json"), 4, changeTo("fives")), "it would be larger than 4 bytes");
    EXPECT_EQ(directory.read("tree.json"), "four");
}

TEST(TreeFile, SaysWhyItsDirectoryCannotBeOpened) {
    const support::TemporaryDirectory directory;
    directory.write("tree.json", "old");
    rlimit usual{};
    ASSERT_EQ(getrlimit(RLIMIT_NOFILE, &usual), 0);
    const TreeChange withoutDescriptors = [&](const std::string&, std::string&) {
        const rlimit none{0, usual.rlim_max};
        setrlimit(RLIMIT_NOFILE, &none);
        return "new";
    };
    const auto replaced = [&] {
        const std::string problem = replaceTreeFile(directory.path("tree.json"), 9, withoutDescriptors);
        setrlimit(RLIMIT_NOFILE, &usual); // whoever looks for leaks at the end opens files
        return problem;
    };
    EXPECT_EQ(support::inChild(replaced), "Too many open files");
    EXPECT_EQ(directory.read("tree.json"), "old");
}

} // namespace

} // namespace VK::Tree
