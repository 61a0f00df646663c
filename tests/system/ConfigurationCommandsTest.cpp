// The CIM server's configuration on KVM guests, where the command lies among the system's own.

#include "support/FakeCommands.h"
#include "support/Isolated.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <optional>

namespace {

using testing::ElementsAre;
using testing::ElementsAreArray;

constexpr char className[] = "VESKA_CIMServiceConfig";

/// A host with two commands: among the system's own and among the product's.
class ConfigurationCommands : public test::NamespaceTest {
protected:
    void SetUp() override {
        NamespaceTest::SetUp();
        if (IsSkipped()) return;
        systemCommands.emplace("/usr/sbin");
        for (const std::filesystem::path& command :
             {std::filesystem::path("/usr/sbin/cimconfig"), commands.path("product/vcm/bin/cimconfig")})
            commands.add(command, "echo 'Current value: 20'");
    }

    std::optional<test::CoveredFolder> systemCommands;
    test::FakeCommands commands;
};

TEST_F(ConfigurationCommands, LieWhereTheKindOfHostSays) {
    const struct {
        bool kvm;
        const char* root; ///< below the test's folder
        std::string command;
    } table[] = {
        {true, "product/platform/", "/usr/sbin/cimconfig"},
        {true, "product/", "/usr/sbin/cimconfig"},
        {false, "product/platform/", "product/vcm/bin/cimconfig"},
        {false, "product/", "product/vcm/bin/cimconfig"},
    };
    for (const auto& row : table) {
        SCOPED_TRACE(std::string(row.kvm ? "KVM" : "no KVM") + ", root " + row.root);
        test::simulate({}, {{"rootDirectory", commands.path(row.root).string()}, {"kvm", row.kvm}});
        test::isolated([&] {
            const om::Answer answer =
                test::invoke(test::path(className), "SetCIMconfig",
                             {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{0}}},
                              {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{4294967295}}}});
            EXPECT_EQ(answer.code, CMPI_RC_OK);
            EXPECT_THAT(commands.take(),
                        ElementsAre(row.command + " [-s] [minIndicationDeliveryRetryInterval=0] [-p]",
                                    row.command + " [-s] [maxIndicationDeliveryRetryAttempts=-1] [-p]"));
            const om::Answer read = test::instances(className);
            ASSERT_EQ(read.results.size(), 1U);
            EXPECT_EQ(std::get<std::uint64_t>(
                          test::find(test::instancesOf(read)[0].properties, "deliveryRetryAttempts")->data),
                      20U);
            EXPECT_THAT(commands.take(), ElementsAre(row.command + " [-g] [minIndicationDeliveryRetryInterval]",
                                                     row.command + " [-g] [maxIndicationDeliveryRetryAttempts]"));
        });
    }
}

TEST_F(ConfigurationCommands, StopAtAFailureOnAKvmGuest) {
    commands.add("/usr/sbin/cimconfig", "exit 1");
    test::simulate({}, {{"kvm", true}});
    test::isolated([&] {
        const om::Answer answer = test::invoke(test::path(className), "SetCIMconfig",
                                               {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{30}}},
                                                {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{5}}}});
        EXPECT_EQ(answer.code, CMPI_RC_ERR_FAILED);
        EXPECT_THAT(commands.take(),
                    ElementsAre("/usr/sbin/cimconfig [-s] [minIndicationDeliveryRetryInterval=30] [-p]"));
    });
}

} // namespace
