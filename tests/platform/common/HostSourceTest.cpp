#include "vk/HostSource.h"
#include "vk/Root.h"

#include "support/InChild.h"
#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>
#include <unistd.h>

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
    EXPECT_EQ(chosenWith(nullptr, "/srv/host.json"), "Simulated /srv/host.json /");
}

TEST(HostSource, IsTakenFromTheWorkingDirectoryOfTheFirstQuestion) {
    const support::TemporaryDirectory first;
    first.write("copy/etc/hostname", "node7\n");
    const auto locationFrom = [&](const char* variable, const char* value) {
        return support::inChild([&] {
            unsetenv("VK_INSTRUMENTATION_ROOT");
            unsetenv("VK_INSTRUMENTATION_TREE");
            setenv(variable, value, 1);
            if (chdir(first.path().c_str()) != 0) return std::string("no such directory");
            HostSource::current();
            if (chdir("/") != 0) return std::string("no root directory");
            return HostSource::current().location + " " + Root::host().getDirectory();
        });
    };
    EXPECT_EQ(locationFrom("VK_INSTRUMENTATION_TREE", "host.json"), first.path("host.json") + " /");
    EXPECT_EQ(locationFrom("VK_INSTRUMENTATION_TREE", "/srv/host.json"), "/srv/host.json /");
    EXPECT_EQ(locationFrom("VK_INSTRUMENTATION_ROOT", "copy"), first.path("copy") + " " + first.path("copy"));
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
    EXPECT_EQ(chosenWith("/usr/lib", "/srv/host.json"), "Simulated /srv/host.json /");
}
