#include "vk/Product.h"

#include "product/UniqueIdentifier.h"
#include "support/InChild.h"
#include "support/TemporaryDirectory.h"
#include "vk/make_string.h"

#include <gmock/gmock.h>
#include <sys/utsname.h>

using support::inChild;
using support::TemporaryDirectory;
using VK::make_string;
using VK::Product;

namespace {

constexpr const char* machineId = "0123456789abcdef0123456789abcdef";

std::string kernelsMachine() {
    utsname names{};
    return uname(&names) == 0 ? names.machine : "";
}

/// Architecture, root directory and identifier in a process whose host is found there.
std::string productFrom(const char* variable, const std::string& value) {
    return inChild([&] {
        unsetenv("VK_INSTRUMENTATION_ROOT");
        unsetenv("VK_INSTRUMENTATION_TREE");
        setenv(variable, value.c_str(), 1);
        return make_string(Product::getArchitecture()) + " " + make_string(Product::getRootDirectory()) + " " +
               make_string(Product::getUid());
    });
}

const std::string rootDirectory = std::string(INSTALL_PREFIX) + "/lib/vk/platform/";

} // namespace

TEST(Product, OfASnapshotIsToldByItsFilesOnly) {
    TemporaryDirectory snapshot;
    EXPECT_EQ(productFrom("VK_INSTRUMENTATION_ROOT", snapshot.path()), kernelsMachine() + " " + rootDirectory + " ");
    snapshot.write("etc/machine-id", std::string(machineId) + "\n");
    snapshot.write("proc/sys/kernel/arch", "ppc64le\n");
    EXPECT_EQ(productFrom("VK_INSTRUMENTATION_ROOT", snapshot.path()),
              "ppc64le " + rootDirectory + " " + VK::uniqueIdentifier(machineId));
}

TEST(Product, HasNoIdentifierWhereTheMachineIdIsNotSetYet) {
    for (const char* text : {"", "\n", "uninitialized\n"}) {
        TemporaryDirectory snapshot;
        snapshot.write("etc/machine-id", text);
        EXPECT_THAT(productFrom("VK_INSTRUMENTATION_ROOT", snapshot.path()), testing::EndsWith("/ ")) << text;
    }
}

TEST(Product, IsReadOncePerProcess) {
    TemporaryDirectory snapshot;
    snapshot.write("etc/machine-id", machineId);
    const std::string result = inChild([&] {
        setenv("VK_INSTRUMENTATION_ROOT", snapshot.path().c_str(), 1);
        const std::wstring first = Product::getUid();
        snapshot.write("etc/machine-id", "other");
        return std::string(!first.empty() && Product::getUid() == first ? "same" : "changed");
    });
    EXPECT_EQ(result, "same");
}

TEST(Product, OfASimulatedHostIsToldByItsFileAndElseByThisHost) {
    TemporaryDirectory directory;
    directory.write(
        "tree.json",
        R"({"product": {"architecture": "riscv64", "uid": "node7", "rootDirectory": "/opt/vk"}, "nodes": []})");
    directory.write("part.json", R"({"product": {"uid": ""}, "nodes": []})");
    EXPECT_EQ(productFrom("VK_INSTRUMENTATION_TREE", directory.path("tree.json")), "riscv64 /opt/vk/ node7");
    EXPECT_EQ(productFrom("VK_INSTRUMENTATION_TREE", directory.path("part.json")),
              kernelsMachine() + " " + rootDirectory + " ");
}

TEST(Product, IsIdentifiedByTheSystemsUuidWithoutAMachineId) {
    TemporaryDirectory snapshot;
    snapshot.write("sys/class/dmi/id/product_uuid", "4C4C4544-0042-4A10-8053-B4C04F4D3132\n");
    EXPECT_EQ(productFrom("VK_INSTRUMENTATION_ROOT", snapshot.path()),
              kernelsMachine() + " " + rootDirectory + " " +
                  VK::uniqueIdentifier("4c4c4544-0042-4a10-8053-b4c04f4d3132"));
}
