#include "vk/ProviderUtilities.h"

#include "support/InChild.h"
#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>

namespace {

std::string kvmSaidBy(const char* variable, const std::string& value) {
    return support::inChild([&] {
        unsetenv("VK_INSTRUMENTATION_ROOT");
        unsetenv("VK_INSTRUMENTATION_TREE");
        setenv(variable, value.c_str(), 1);
        return std::string(VK::ProviderUtilities::isKVM() ? "yes" : "no");
    });
}

} // namespace

TEST(IsKVM, IsToldByTheHostsSource) {
    support::TemporaryDirectory directory;
    directory.write("yes.json", R"({"product": {"kvm": true}, "nodes": []})");
    directory.write("no.json", R"({"product": {"kvm": false}, "nodes": []})");
    EXPECT_EQ(kvmSaidBy("VK_INSTRUMENTATION_TREE", directory.path("yes.json")), "yes");
    EXPECT_EQ(kvmSaidBy("VK_INSTRUMENTATION_TREE", directory.path("no.json")), "no");
    EXPECT_EQ(kvmSaidBy("VK_INSTRUMENTATION_ROOT", directory.path()), "no");
    directory.write("sys/class/dmi/id/sys_vendor", "QEMU\n");
    EXPECT_EQ(kvmSaidBy("VK_INSTRUMENTATION_ROOT", directory.path()), "yes");
}
