// The CIM server's configuration: on KVM guests, where the command lies among the system's own, and asked for by
// several processes at once.

#include "support/FakeCommands.h"
#include "support/Isolated.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <optional>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

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

    std::optional<test::CoveredDirectory> systemCommands;
    test::FakeCommands commands;
};

TEST_F(ConfigurationCommands, LieWhereTheKindOfHostSays) {
    const struct {
        bool kvm;
        const char* root; ///< below the test's directory
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

/// The same with a /run of the test's own.
class ConfigurationLock : public ConfigurationCommands {
protected:
    void SetUp() override {
        ConfigurationCommands::SetUp();
        if (IsSkipped()) return;
        run.emplace("/run");
        test::simulate({}, {{"kvm", true}});
    }

    static void set() {
        const om::Answer answer = test::invoke(test::path(className), "SetCIMconfig",
                                               {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{30}}},
                                                {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{5}}}});
        EXPECT_EQ(answer.code, CMPI_RC_OK);
    }

    std::optional<test::CoveredDirectory> run;
};

TEST_F(ConfigurationLock, LetsOneProcessSetAtATime) {
    commands.add("/usr/sbin/cimconfig", test::notingOverlaps(commands.path("").string()));
    std::fflush(nullptr);
    for (int i = 0; i < 6; ++i) {
        if (fork() != 0) continue;
        set();
        _exit(HasFailure() ? 1 : 0);
    }
    for (int i = 0; i < 6; ++i) {
        int status = -1;
        EXPECT_GT(wait(&status), 0);
        EXPECT_EQ(status, 0);
    }
    EXPECT_THAT(commands.take(), testing::SizeIs(12));
    EXPECT_FALSE(std::filesystem::exists(commands.path("overlaps")));
}

TEST_F(ConfigurationLock, IsNotTakenForReading) {
    test::isolated([] {
        EXPECT_EQ(test::instances(className).results.size(), 1U);
        EXPECT_TRUE(std::filesystem::is_empty("/run"));
        set();
        EXPECT_TRUE(std::filesystem::exists("/run/vk-cimconfig.lock"));
    });
}

TEST_F(ConfigurationLock, IsNotNeededForSetting) {
    ASSERT_EQ(chmod("/run", 01777), 0); // a file there would be anybody's
    test::isolated([] {
        set();
        EXPECT_TRUE(std::filesystem::is_empty("/run"));
    });
}

} // namespace
