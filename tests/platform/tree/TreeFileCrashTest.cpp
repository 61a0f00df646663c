#include "tree/TreeFile.h"

#include "support/KilledRun.h"
#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <set>

namespace VK::Tree {

namespace {

constexpr std::size_t limit = std::size_t{1} << 20;

/// Puts a text in the place of another; why it did not, where it did not.
std::string replace(const std::string& file, const std::string& before, const std::string& after) {
    return replaceTreeFile(file, limit, [&](const std::string& found, std::string& problem) {
        if (found != before) problem = "it was not there before";
        return after;
    });
}

std::set<std::string> namesIn(const std::string& directory) {
    std::set<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(directory)) names.insert(entry.path().filename());
    return names;
}

TEST(TreeFileCrash, LeavesTheOldTextOrTheNewOneAndLetsTheNextWriterIn) {
    // Of different lengths, and more than one page.
    const std::string before(9000, 'o');
    const std::string after(14000, 'n');
    const support::InMemory<support::TemporaryDirectory> memory;
    const support::TemporaryDirectory& directory = *memory;
    const std::string file = directory.path("tree.json");
    int old = 0, fresh = 0;
    for (support::Outcome outcome = support::Killed; outcome == support::Killed;) {
        const int calls = old + fresh;
        directory.write("tree.json", before);
        std::filesystem::permissions(file, std::filesystem::perms(0640));
        outcome = support::runKilledAt([&] { replace(file, before, after); }, calls);
        if (outcome == support::NotTraced) GTEST_SKIP() << "processes may not be traced here";
        const std::string found = directory.read("tree.json");
        ASSERT_TRUE(found == before || found == after) << found.size() << " bytes after " << calls << " calls";
        ++(found == before ? old : fresh);
        EXPECT_EQ(std::filesystem::status(file).permissions(), std::filesystem::perms(0640)) << calls;
        ASSERT_EQ(replace(file, found, "next"), "") << "after " << calls << " calls";
        EXPECT_EQ(directory.read("tree.json"), "next");
        EXPECT_EQ(namesIn(directory.path()), (std::set<std::string>{"tree.json", "tree.json.lock"})) << calls;
    }
    EXPECT_GT(old, 10);  // there were some calls to kill at, before the text was put in its place
    EXPECT_GT(fresh, 1); // and behind that, but for the run that came to its end
}

} // namespace

} // namespace VK::Tree
