// What this host, made of a few files, says of the product: of itself, and where a simulated host's file is silent.

#include "product/UniqueIdentifier.h"
#include "support/InChild.h"
#include "support/TemporaryDirectory.h"
#include "system/Namespaces.h"
#include "vk/Product.h"
#include "vk/make_string.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <sys/utsname.h>

namespace {

using VK::make_string;
using VK::Product;

constexpr const char* machineId = "0123456789abcdef0123456789abcdef";
constexpr const char* uuid = "4c4c4544-0042-4a10-8053-b4c04f4d3132";

void write(const std::filesystem::path& file, const std::string& text) {
    std::filesystem::create_directories(file.parent_path());
    std::ofstream(file) << text;
}

class HostProduct : public test::NamespaceTest {};

TEST_F(HostProduct, ComesFromTheKernelAndTheMachineId) {
    const test::CoveredDirectory etc("/etc");
    write("/etc/machine-id", std::string(machineId) + "\n");
    utsname kernel{};
    ASSERT_EQ(uname(&kernel), 0);
    const std::string product = support::inChild([] {
        unsetenv("VK_INSTRUMENTATION_ROOT");
        unsetenv("VK_INSTRUMENTATION_TREE");
        return make_string(Product::getArchitecture()) + " " + make_string(Product::getRootDirectory()) + " " +
               make_string(Product::getUid());
    });
    EXPECT_EQ(product,
              std::string(kernel.machine) + " " INSTALL_PREFIX "/lib/vk/platform/ " + VK::uniqueIdentifier(machineId));
}

class SimulatedProduct : public test::NamespaceTest {
protected:
    /// The identifier on a host that a file describes, which holds a computer with a uuid of its own.
    std::string identifier() const {
        support::TemporaryDirectory directory;
        directory.write("tree.json", R"({"nodes":[{"type":40,"path":"/c",)"
                                     R"("properties":{"64":"00112233-4455-6677-8899-aabbccddeeff"}}]})");
        return support::inChild([&] {
            unsetenv("VK_INSTRUMENTATION_ROOT");
            setenv("VK_INSTRUMENTATION_TREE", directory.path("tree.json").c_str(), 1);
            return make_string(Product::getUid());
        });
    }
};

TEST_F(SimulatedProduct, IsIdentifiedByThisHostsMachineId) {
    const test::CoveredDirectory etc("/etc"), sys("/sys");
    write("/etc/machine-id", std::string(machineId) + "\n");
    write("/sys/class/dmi/id/product_uuid", uuid);
    EXPECT_EQ(identifier(), VK::uniqueIdentifier(machineId));
}

TEST_F(SimulatedProduct, IsIdentifiedByThisHostsUuidWithoutAMachineId) {
    const test::CoveredDirectory etc("/etc"), sys("/sys");
    write("/sys/class/dmi/id/product_uuid", uuid);
    EXPECT_EQ(identifier(), VK::uniqueIdentifier(uuid));
}

} // namespace
