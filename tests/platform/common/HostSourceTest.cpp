#include "vk/HostSource.h"
#include "vk/Root.h"

#include "support/InChild.h"

#include <gtest/gtest.h>

using VK::HostSource;
using VK::Root;

namespace {

/// Kind, location and root's directory in a process with these two variables; a null one is not set.
std::string chosenWith(const char* root, const char* tree) {
    return support::inChild([&] {
        root != nullptr ? setenv("VK_INSTRUMENTATION_ROOT", root, 1) : unsetenv("VK_INSTRUMENTATION_ROOT");
        tree != nullptr ? setenv("VK_INSTRUMENTATION_TREE", tree, 1) : unsetenv("VK_INSTRUMENTATION_TREE");
        const HostSource first = HostSource::current();
        setenv("VK_INSTRUMENTATION_ROOT", "/too/late", 1);
        EXPECT_EQ(&HostSource::current(), &HostSource::current());
        EXPECT_EQ(HostSource::current().location, first.location);
        const char* const kinds[] = {"Live", "Snapshot", "Simulated"};
        return std::string(kinds[first.kind]) + " " + first.location + " " + Root::host().getDirectory();
    });
}

} // namespace

TEST(HostSource, IsThisHostByDefault) {
    EXPECT_EQ(chosenWith(nullptr, nullptr), "Live  /");
    EXPECT_EQ(chosenWith("", ""), "Live  /");
}

TEST(HostSource, IsASnapshotOrASimulatedHost) {
    EXPECT_EQ(chosenWith("/usr/lib", nullptr), "Snapshot /usr/lib /usr/lib");
    EXPECT_EQ(chosenWith("/nowhere/at/all", ""), "Snapshot /nowhere/at/all /nowhere/at/all");
    EXPECT_EQ(chosenWith(nullptr, "host.json"), "Simulated host.json /");
}

TEST(HostSource, IsASnapshotAlsoAtTheTopWhereNothingOfTheRunningHostMayBeChanged) {
    for (const char* root : {"/", "/usr/.."}) {
        EXPECT_EQ(chosenWith(root, nullptr), std::string("Snapshot ") + root + " /");
        const std::string found = support::inChild([&] {
            setenv("VK_INSTRUMENTATION_ROOT", root, 1);
            EXPECT_TRUE(Root::host().exists("/etc"));
            return std::string(Root::host().isLive() ? "live" : "not live");
        });
        EXPECT_EQ(found, "not live");
    }
}

TEST(HostSource, PrefersATreeToARoot) {
    EXPECT_EQ(chosenWith("/usr/lib", "host.json"), "Simulated host.json /");
}
