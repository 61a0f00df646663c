#include "cmpi/CMPICIMServiceConfig.h"
#include "support/FakeCommands.h"
#include "support/Isolated.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

#include <sys/resource.h>

namespace {

using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;
using testing::SizeIs;
using VK::BaseServerProvider::CMPICIMServiceConfig;

constexpr char className[] = "VESKA_CIMServiceConfig";
constexpr char command[] = "product/vcm/bin/cimconfig";

const std::string setInterval = std::string(command) + " [-s] [minIndicationDeliveryRetryInterval=";
const std::string setAttempts = std::string(command) + " [-s] [maxIndicationDeliveryRetryAttempts=";
const std::string getInterval = std::string(command) + " [-g] [minIndicationDeliveryRetryInterval]";
const std::string getAttempts = std::string(command) + " [-g] [maxIndicationDeliveryRetryAttempts]";

om::NamedValue uint32(const std::string& name, std::uint64_t value) {
    return {name, {CMPI_uint32, value}};
}
om::NamedValue interval(std::uint64_t value) {
    return uint32("deliveryRetryIntervalSec", value);
}
om::NamedValue attempts(std::uint64_t value) {
    return uint32("deliveryRetryAttempts", value);
}

om::Answer configure(const std::vector<om::NamedValue>& in, const std::string& method = "SetCIMconfig") {
    return test::invoke(test::path(className), method, in);
}

/// A host whose product's root directory is `product/platform/` in a directory of the test's own.
class CMPICIMServiceConfigTest : public testing::Test {
protected:
    CMPICIMServiceConfigTest() {
        test::simulate({}, {{"rootDirectory", commands.path("product/platform/").string()}, {"kvm", false}});
    }
    /// What the command does after its call was recorded; it sees its arguments.
    void addCommand(const std::string& script) { commands.add(commands.path(command), script); }

    test::FakeCommands commands;
};

TEST_F(CMPICIMServiceConfigTest, HasOnePathWithItsKeysInOrder) {
    const om::Answer answer = test::names(className);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done) << "the result is left open, which is meant";
    ASSERT_THAT(answer.results, SizeIs(1));
    EXPECT_EQ(test::print(test::paths(answer)[0]),
              "VESKA_CIMServiceConfig.Name=\"VESKA_CIMServiceConfig\",CreationClassName=\"VESKA_CIMServiceConfig\"");
}

TEST_F(CMPICIMServiceConfigTest, ReadsBothValuesForEveryInstance) {
    addCommand("case $2 in min*) echo 'Current value: 30';; *) echo 'Current value: 4294967295';; esac");
    test::isolated([&] {
        for (const bool all : {true, false}) {
            const om::Answer answer =
                all ? test::instances(className) : test::get(test::path(className, {{"Name", "another"}}));
            EXPECT_EQ(answer.code, CMPI_RC_OK);
            EXPECT_FALSE(answer.done) << "the result is left open, which is meant";
            ASSERT_THAT(answer.results, SizeIs(1));
            const om::Instance instance = test::instancesOf(answer)[0];
            const om::Value name = {CMPI_string, std::string(className)};
            EXPECT_THAT(instance.properties,
                        ElementsAre(om::NamedValue("Name", name), om::NamedValue("CreationClassName", name),
                                    interval(30), attempts(4294967295)));
            EXPECT_THAT(commands.take(), ElementsAre(getInterval, getAttempts));
        }
    });
}

TEST_F(CMPICIMServiceConfigTest, PublishesZerosWhereTheCommandPrintsNothing) {
    addCommand("exit 0");
    test::isolated([&] {
        const om::Instance instance = test::instancesOf(test::instances(className)).at(0);
        EXPECT_THAT(instance.properties, testing::IsSupersetOf({interval(0), attempts(0)}));
    });
}

TEST_F(CMPICIMServiceConfigTest, LeavesTheValuesOutWhenTheCommandCannotBeStarted) {
    addCommand("echo 'Current value: 30'");
    test::isolated([] {
        test::instances(className); // what is opened once is open from now on
        rlimit usual = {};
        ASSERT_EQ(getrlimit(RLIMIT_NOFILE, &usual), 0);
        const rlimit none = {0, usual.rlim_max};
        ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &none), 0);
        const om::Answer answer = test::instances(className);
        ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &usual), 0);
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        ASSERT_THAT(answer.results, SizeIs(1));
        EXPECT_THAT(test::namesOf(test::instancesOf(answer)[0].properties), ElementsAre("Name", "CreationClassName"));
    });
}

TEST_F(CMPICIMServiceConfigTest, SetsWhatTheArgumentsSay) {
    const struct {
        std::vector<om::NamedValue> in;
        std::vector<std::string> calls;
        CMPIrc code;
    } table[] = {
        {{}, {}, CMPI_RC_ERR_INVALID_PARAMETER},
        {{interval(30)}, {setInterval + "30] [-p]"}, CMPI_RC_OK},
        {{attempts(5)}, {setAttempts + "5] [-p]"}, CMPI_RC_OK},
        {{interval(30), attempts(5)}, {setInterval + "30] [-p]", setAttempts + "5] [-p]"}, CMPI_RC_OK},
        {{attempts(5), interval(30)}, {setInterval + "30] [-p]", setAttempts + "5] [-p]"}, CMPI_RC_OK},
        {{interval(0), attempts(0)}, {setInterval + "0] [-p]", setAttempts + "0] [-p]"}, CMPI_RC_OK},
        {{interval(2147483647)}, {setInterval + "2147483647] [-p]"}, CMPI_RC_OK},
        {{interval(2147483648), attempts(4294967295)}, // signed on purpose
         {setInterval + "-2147483648] [-p]", setAttempts + "-1] [-p]"},
         CMPI_RC_OK},
        {{attempts(5), uint32("another", 1), uint32("third", 2), uint32("fourth", 3)},
         {setAttempts + "5] [-p]"},
         CMPI_RC_OK},
        {{uint32("another", 1)}, {}, CMPI_RC_ERR_INVALID_PARAMETER},
        // Arguments of another type and nulls count as absent.
        {{{"deliveryRetryIntervalSec", {CMPI_string, std::string("30")}}}, {}, CMPI_RC_ERR_INVALID_PARAMETER},
        {{{"deliveryRetryIntervalSec", {CMPI_uint64, std::uint64_t{30}}}}, {}, CMPI_RC_ERR_INVALID_PARAMETER},
        {{{"deliveryRetryIntervalSec", {CMPI_uint32, {}}}, attempts(5)}, {setAttempts + "5] [-p]"}, CMPI_RC_OK},
    };
    addCommand("exit 0");
    test::isolated([&] {
        for (const auto& row : table) {
            const om::Answer answer = configure(row.in);
            SCOPED_TRACE(testing::PrintToString(row.calls) + " of " + testing::PrintToString(test::namesOf(row.in)));
            EXPECT_EQ(answer.code, row.code);
            EXPECT_TRUE(answer.done);
            EXPECT_EQ(std::get<std::uint64_t>(answer.returnValue->data), static_cast<unsigned>(row.code));
            EXPECT_THAT(answer.out, IsEmpty());
            EXPECT_THAT(commands.take(), ElementsAreArray(row.calls));
        }
    });
}

TEST_F(CMPICIMServiceConfigTest, EndsAtTheFirstCommandThatFails) {
    const std::string first = setInterval + "30] [-p]";
    const std::string second = setAttempts + "5] [-p]";
    const struct {
        const char* script;
        std::vector<om::NamedValue> in;
        std::vector<std::string> calls;
        CMPIrc code;
    } table[] = {
        {"case $2 in min*) exit 1;; esac", {interval(30), attempts(5)}, {first}, CMPI_RC_ERR_FAILED},
        {"case $2 in max*) exit 1;; esac", {interval(30), attempts(5)}, {first, second}, CMPI_RC_ERR_FAILED},
        {"exit 1", {interval(30), attempts(5)}, {first}, CMPI_RC_ERR_FAILED},
        {"exit 2", {interval(30)}, {first}, CMPI_RC_ERR_FAILED},
        {"exit 3", {attempts(5)}, {second}, CMPI_RC_ERR_FAILED},
        {"case $2 in min*) exit 1;; esac", {attempts(5)}, {second}, CMPI_RC_OK},
        {"case $2 in max*) exit 1;; esac", {interval(30)}, {first}, CMPI_RC_OK},
    };
    test::isolated([&] {
        for (const auto& row : table) {
            SCOPED_TRACE(row.script);
            addCommand(row.script);
            const om::Answer answer = configure(row.in);
            EXPECT_EQ(answer.code, row.code);
            EXPECT_EQ(std::get<std::uint64_t>(answer.returnValue->data), static_cast<unsigned>(row.code));
            EXPECT_THAT(commands.take(), ElementsAreArray(row.calls));
        }
    });
}

TEST_F(CMPICIMServiceConfigTest, TakesTheMethodNameInAnyCase) {
    addCommand("exit 0");
    test::isolated([&] {
        for (const char* name : {"SetCIMconfig", "setcimconfig", "SETCIMCONFIG"})
            EXPECT_EQ(configure({attempts(5)}, name).code, CMPI_RC_OK) << name;
        EXPECT_THAT(commands.take(), SizeIs(3));
        for (const char* name : {"ManageTime", "SetCIMconfig2", "Set", ""})
            EXPECT_EQ(configure({attempts(5)}, name).code, CMPI_RC_ERR_METHOD_NOT_FOUND) << name;
        EXPECT_THAT(commands.take(), IsEmpty());
    });
}

TEST_F(CMPICIMServiceConfigTest, RefusesMissingArgumentsAndACountThatFailsButNoCount) {
    const CMPIBroker* const broker = test::provider().broker();
    CMPIObjectPath* const path = CMNewObjectPath(broker, "root/cimv2", className, nullptr);
    CMPICIMServiceConfig adapter(broker, nullptr, path);
    EXPECT_EQ(adapter.invokeMethod("SetCIMconfig", nullptr, nullptr, nullptr), 4U);
    EXPECT_EQ(adapter.invokeMethod(nullptr, nullptr, nullptr, nullptr), 17U);
    CMPIArgs* const arguments = CMNewArgs(broker, nullptr);
    addCommand("exit 0");
    CMPIArgsFT table = *arguments->ft;
    table.getArg = [](const CMPIArgs*, const char*, CMPIStatus*) {
        CMPIData given = {CMPI_uint32, CMPI_goodValue, {}};
        given.value.uint32 = 5;
        return given;
    };
    table.getArgCount = [](const CMPIArgs*, CMPIStatus* status) -> CMPICount {
        status->rc = CMPI_RC_ERR_FAILED;
        return 1;
    };
    const CMPIArgs failing = {arguments->hdl, &table};
    test::isolated([&] {
        EXPECT_EQ(adapter.invokeMethod("SetCIMconfig", &failing, nullptr, nullptr), 4U);
        table.getArgCount = nullptr;
        EXPECT_EQ(adapter.invokeMethod("SetCIMconfig", &failing, nullptr, nullptr), 4U);
        EXPECT_THAT(commands.take(), IsEmpty());
        table.getArgCount = [](const CMPIArgs*, CMPIStatus*) -> CMPICount { return 0; }; // the count does not matter
        EXPECT_EQ(adapter.invokeMethod("SetCIMconfig", &failing, nullptr, nullptr), 0U);
        EXPECT_THAT(commands.take(), SizeIs(2));
    });
}

} // namespace
