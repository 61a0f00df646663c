#include "vk/Instrumentation.h"

#include "support/SmbiosImage.h"
#include "vk/HostFacts.h"
#include "vk/HostNotes.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <functional>
#include <unistd.h>

namespace VK {

namespace {

using Lexicon = NodeLexicon;

constexpr auto nameProperty = Lexicon::NameProperty;
constexpr auto offset = Lexicon::GmtOffsetProperty;

/// A process chooses its host once: each test runs in one of its own, and fails by what it prints.
#define IN_PROCESS_WITH(variable, value, body)                                                                         \
    EXPECT_EXIT(                                                                                                       \
        {                                                                                                              \
            setenv(variable, (value).c_str(), 1);                                                                      \
            body();                                                                                                    \
            fflush(stdout);                                                                                            \
            _exit(testing::Test::HasFailure() ? 1 : 0);                                                                \
        },                                                                                                             \
        testing::ExitedWithCode(0), "")

class InstrumentationTest : public testing::Test {
protected:
    support::TemporaryDirectory directory;
};

TEST_F(InstrumentationTest, ACursorOnNothingKnowsNothing) {
    directory.write("tree.json", R"({"nodes":[]})");
    IN_PROCESS_WITH("VK_INSTRUMENTATION_TREE", directory.path("tree.json"), [] {
        Instrumentation cursor;
        std::string text = "before";
        unsigned int number = 7;
        bool readOnly = true;
        EXPECT_FALSE(cursor);
        EXPECT_FALSE(++cursor);
        EXPECT_FALSE(cursor.getProperty(nameProperty, text));
        EXPECT_FALSE(cursor.getProperty(nameProperty, number));
        EXPECT_FALSE(cursor.setProperty(nameProperty, text));
        EXPECT_FALSE(cursor.setProperty(nameProperty, number));
        EXPECT_FALSE(cursor.isPropertyReadOnly(nameProperty, readOnly));
        EXPECT_EQ(text, "before");
        EXPECT_EQ(number, 7U);
        EXPECT_TRUE(readOnly);
        EXPECT_EQ(cursor.getNodeStatus(), 0U);
        EXPECT_EQ(cursor.getNodeDescription(), "");
        EXPECT_EQ(cursor.getPathToNode(), NodePath());
        EXPECT_EQ(cursor.getPathToParentNode(), NodePath());
        cursor.setFilter(Lexicon::NamePath, "/");
        EXPECT_FALSE(cursor);
    });
}

TEST_F(InstrumentationTest, ReadsAndWritesASimulatedHost) {
    directory.write("tree.json", R"({"product":{"kvm":true,"uid":"u"},"nodes":[
        {"type":40,"path":"/c","status":20,"description":"Rack","properties":{"108":"node7","127":60},"readOnly":[108]},
        {"type":1,"path":"/c/x","parent":"/c"}]})");
    IN_PROCESS_WITH("VK_INSTRUMENTATION_TREE", directory.path("tree.json"), [] {
        Instrumentation cursor;
        cursor.selectNode(Lexicon::ComputerSystemNode);
        ASSERT_TRUE(bool(cursor));
        EXPECT_EQ(cursor.getNodeStatus(), 20U);
        EXPECT_EQ(cursor.getNodeDescription(), "Rack");
        std::string text;
        unsigned int number = 0;
        EXPECT_TRUE(cursor.getProperty(nameProperty, text));
        EXPECT_EQ(text, "node7");
        EXPECT_FALSE(cursor.getProperty(nameProperty, number)); // it is a text
        EXPECT_TRUE(cursor.getProperty(offset, number));
        EXPECT_EQ(number, 60U);
        EXPECT_FALSE(cursor.getProperty(offset, text)); // it is a number
        EXPECT_EQ(text, "node7");
        bool readOnly = false;
        EXPECT_TRUE(cursor.isPropertyReadOnly(nameProperty, readOnly));
        EXPECT_TRUE(readOnly);
        number = 4294966996U;
        EXPECT_TRUE(cursor.setProperty(offset, number));
        EXPECT_FALSE(cursor.setProperty(nameProperty, text));

        Instrumentation chassis;
        chassis.selectNode(std::string("/c/x"));
        EXPECT_EQ(std::string(chassis.getPathToNode()), "/c/x");
        EXPECT_EQ(chassis.getPathToParentNode(), cursor.getPathToNode());
        chassis.selectNode(Lexicon::ComputerSystemNode);
        chassis.setFilter(static_cast<Lexicon::PathType>(1), "/c"); // no other path type is known
        EXPECT_FALSE(bool(chassis));
        chassis.selectNode(Lexicon::ComputerSystemNode);
        EXPECT_TRUE(chassis.getProperty(offset, number));
        EXPECT_EQ(number, 4294966996U);

        EXPECT_EQ(Instrumentation::convertPathToString(Instrumentation::convertStringToPath("/c/x")), "/c/x");
        EXPECT_TRUE(hostIsKVM());
        EXPECT_EQ(productOverrides().uid, "u");
        EXPECT_FALSE(productOverrides().architecture.has_value());
        EXPECT_EQ(hostNotes().front().rfind("time service: NTP daemon ", 0), 0U) << "nothing is missing";
    });
}

TEST_F(InstrumentationTest, SaysInANoteWhyATreeIsEmpty) {
    const std::string file = directory.path("missing.json");
    IN_PROCESS_WITH("VK_INSTRUMENTATION_TREE", file, [&file] {
        Instrumentation cursor;
        cursor.selectNode(Lexicon::ComputerSystemNode);
        EXPECT_FALSE(bool(cursor));
        EXPECT_EQ(hostNotes().front(), file + ": No such file or directory");
    });
}

/// What a function of vk/HostNotes.h hands over, each line ended.
std::string handed(void (*ask)(VkHostNote, void*)) {
    std::string all;
    ask([](void* context, const char* note) { static_cast<std::string*>(context)->append(note) += '\n'; }, &all);
    return all;
}

TEST_F(InstrumentationTest, SaysWhichHostItReadsAndWhyItCannot) {
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", directory.path(), [this] {
        EXPECT_EQ(handed(vkHostProblem), "");
        EXPECT_EQ(handed(vkHostSource), "the snapshot in " + directory.path() + '\n');
    });
    const std::string gone = directory.path("gone");
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", gone,
                    [&gone] { EXPECT_EQ(handed(vkHostProblem), gone + ": No such file or directory\n"); });
    directory.write("file", "{}");
    const std::string file = directory.path("file");
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", file,
                    [&file] { EXPECT_EQ(handed(vkHostProblem), file + ": Not a directory\n"); });
    IN_PROCESS_WITH("VK_INSTRUMENTATION_TREE", file, [&file] {
        EXPECT_THAT(handed(vkHostProblem), testing::StartsWith(file + ": "));
        EXPECT_EQ(handed(vkHostSource), "the simulated host in " + file + '\n');
    });
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", std::string(), [] {
        EXPECT_EQ(handed(vkHostProblem), "");
        EXPECT_EQ(handed(vkHostSource), "");
    });
}

TEST_F(InstrumentationTest, HandsOverTheHostsTimeAndOffsetWhereItHasThem) {
    directory.write("tree.json", R"({"nodes":[{"type":40,"path":"/c",
        "properties":{"126":"20261121060000.000000-300","127":4294966996}}]})");
    IN_PROCESS_WITH("VK_INSTRUMENTATION_TREE", directory.path("tree.json"), [] {
        EXPECT_EQ(handed(vkHostTime), "20261121060000.000000-300\n");
        EXPECT_EQ(handed(vkHostOffset), "-300\n");
    });
    directory.write("without.json", R"({"nodes":[{"type":40,"path":"/c","properties":{"126":""}}]})");
    IN_PROCESS_WITH("VK_INSTRUMENTATION_TREE", directory.path("without.json"), [] {
        EXPECT_EQ(handed(vkHostTime), "");
        EXPECT_EQ(handed(vkHostOffset), "");
    });
}

TEST_F(InstrumentationTest, KnowsASnapshotsFirmwareFromItsFilesAlone) {
    support::SmbiosImage(3, 0)
        .add(support::SmbiosSystemImage{"QEMU", "Standard PC", {}, {}, {}, {}})
        .writeTo(directory);
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", directory.path(), [] { EXPECT_TRUE(hostIsKVM()); });
    support::SmbiosImage(3, 0).add(support::SmbiosSystemImage{"Veska", "KVM", {}, {}, {}, {}}).writeTo(directory);
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", directory.path(), [] { EXPECT_TRUE(hostIsKVM()); });
    support::SmbiosImage(3, 0).add(support::SmbiosSystemImage{"Veska", "VS", {}, {}, {}, {}}).writeTo(directory);
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", directory.path(), [] { EXPECT_FALSE(hostIsKVM()); });
}

TEST_F(InstrumentationTest, ThisHostIsOneComputerWithTheKernelsName) {
    IN_PROCESS_WITH("VK_INSTRUMENTATION_ROOT", std::string(), [] { // empty counts as not set
        char kernels[129] = {};
        ASSERT_EQ(gethostname(kernels, 128), 0);
        Instrumentation cursor;
        cursor.selectNode(Lexicon::ComputerSystemNode);
        std::string name;
        EXPECT_TRUE(cursor.getProperty(nameProperty, name));
        EXPECT_EQ(name, kernels);
        EXPECT_EQ(std::string(cursor.getPathToNode()), "/computer/0");
        EXPECT_FALSE(++cursor);
    });
}

} // namespace

} // namespace VK
