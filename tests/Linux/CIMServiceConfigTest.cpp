#include "Linux/CIMServiceConfig.h"
#include "support/FakeCommands.h"
#include "support/HostName.h"
#include "support/Isolated.h"
#include "support/ShellCalls.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <csignal>
#include <thread>

namespace {

using testing::Contains;
using testing::ContainsRegex;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using VK::BaseServerProvider::CIMServiceConfig;

const std::string intervalProperty = "minIndicationDeliveryRetryInterval";
const std::string attemptsProperty = "maxIndicationDeliveryRetryAttempts";

/// A host whose product's root directory is `product/platform/` in a directory of the test's own. Each test that asks
/// for the command runs in a process of its own, since the libraries read the product's facts once.
class CIMServiceConfigTest : public testing::Test {
protected:
    CIMServiceConfigTest() { host(commands.path("product/platform/").string(), false); }
    ~CIMServiceConfigTest() override { test::refuseToStart(""); }

    void host(const std::string& root, bool kvm) { test::simulate({}, {{"rootDirectory", root}, {"kvm", kvm}}); }
    void addCommand(const std::string& script) { commands.add(commands.path("product/vcm/bin/cimconfig"), script); }
    std::string command() const { return commands.path("product/vcm/bin/cimconfig").string(); }

    test::FakeCommands commands;
};

std::string binDirectory() {
    return CIMServiceConfig().getbinDirectory();
}

TEST_F(CIMServiceConfigTest, IsNamedAfterItsClass) {
    const CIMServiceConfig config;
    const struct {
        const char* name;
        bool (CIMServiceConfig::*getter)(std::string&) const;
        std::string expected;
    } texts[] = {
        {"getName", &CIMServiceConfig::getName, "VESKA_CIMServiceConfig"},
        {"getCreationClassName", &CIMServiceConfig::getCreationClassName, "VESKA_CIMServiceConfig"},
        {"getSystemCreationClassName", &CIMServiceConfig::getSystemCreationClassName, "VESKA_ComputerSystem"},
        {"getSystemName", &CIMServiceConfig::getSystemName, test::hostName()},
    };
    for (const auto& [name, getter, expected] : texts) {
        std::string text;
        test::takeLog();
        EXPECT_TRUE((config.*getter)(text));
        EXPECT_EQ(text, expected);
        EXPECT_THAT(test::takeLog(), Contains(ContainsRegex(" LOG 4000 .* " + std::string(name) + ": ENTERING: ")));
    }
}

TEST_F(CIMServiceConfigTest, FindsTheCommandsBesideThePlatform) {
    const struct {
        const char* root;
        const char* directory;
    } table[] = {
        {"/opt/vk/platform/", "/opt/vk/vcm/bin/"},
        {"/opt/vk/platform", "/opt/vk/vcm/bin/"},
        {"/opt/vk/platform-2/lib/", "/opt/vk/vcm/bin/"},
        {"/srv/platform/x/platform/", "/srv/vcm/bin/"},
        {"/opt/vk/", "/opt/vk/vcm/bin/"},
        {"/opt/Platform/", "/opt/Platform/vcm/bin/"},
        // On purpose, only the low byte of each wide character is kept.
        {"/opt/v\xC3\xA4/platform/", "/opt/v\xE4/vcm/bin/"},
        {"/opt/\xC4\x80k/platform/", "/opt/\0k/vcm/bin/"},
    };
    for (const auto& row : table) {
        test::isolated([&] {
            host(row.root, false);
            EXPECT_STREQ(binDirectory().c_str(), row.directory) << row.root;
        });
    }
}

TEST_F(CIMServiceConfigTest, SetsWithThisCommand) {
    addCommand("exit 0");
    test::isolated([&] {
        CIMServiceConfig config;
        EXPECT_EQ(config.setIntervalParameter("30"), 0U);
        EXPECT_EQ(config.setAttemptParameter("5"), 0U);
        EXPECT_THAT(test::takeShellCalls(), ElementsAre("system: " + command() + " -s " + intervalProperty + "=30 -p",
                                                        "system: " + command() + " -s " + attemptsProperty + "=5 -p"));
        EXPECT_THAT(commands.take(), ElementsAre("product/vcm/bin/cimconfig [-s] [" + intervalProperty + "=30] [-p]",
                                                 "product/vcm/bin/cimconfig [-s] [" + attemptsProperty + "=5] [-p]"));
    });
}

TEST_F(CIMServiceConfigTest, InsertsTheValueAsItIs) {
    addCommand("exit 0");
    test::isolated([&] {
        EXPECT_EQ(CIMServiceConfig().setIntervalParameter("1 2"), 0U);
        EXPECT_THAT(commands.take(),
                    ElementsAre("product/vcm/bin/cimconfig [-s] [" + intervalProperty + "=1] [2] [-p]"));
    });
}

TEST_F(CIMServiceConfigTest, RunsOneSetAtATimeAmongTheThreads) {
    addCommand(test::notingOverlaps(commands.path("").string()));
    test::isolated([&] {
        std::vector<std::thread> threads;
        for (int i = 0; i < 6; ++i)
            threads.emplace_back([i] {
                CIMServiceConfig config;
                EXPECT_EQ(i % 2 == 0 ? config.setIntervalParameter("30") : config.setAttemptParameter("5"), 0U);
            });
        for (std::thread& thread : threads) thread.join();
        EXPECT_THAT(commands.take(), testing::SizeIs(6));
        EXPECT_FALSE(std::filesystem::exists(commands.path("overlaps")));
    });
}

TEST_F(CIMServiceConfigTest, AnswersOneWhenTheSetFails) {
    for (const char* script : {"exit 1", "exit 255", "kill -9 $$"}) {
        addCommand(script);
        test::isolated([&] {
            test::takeLog();
            EXPECT_EQ(CIMServiceConfig().setIntervalParameter("30"), 1U) << script;
            EXPECT_EQ(CIMServiceConfig().setAttemptParameter("30"), 1U) << script;
            EXPECT_THAT(test::takeLog(),
                        Contains(ContainsRegex(" LOG 6000 .* setIntervalParameter: VARIABLE: 'command failed' has "
                                               "Value '" +
                                               command() + " -s " + intervalProperty + "=30 -p'")));
        });
    }
}

TEST_F(CIMServiceConfigTest, AnswersOneWhenTheSetCannotBeStartedOrIsNotThere) {
    for (const char* refused : {"cimconfig", ""})
        test::isolated([&] {
            test::refuseToStart(refused);
            EXPECT_EQ(CIMServiceConfig().setIntervalParameter("30"), 1U) << refused;
            std::string request = "deliveryRetryAttempts=5";
            EXPECT_EQ(CIMServiceConfig().executeCIMServiceConfig(request), 1U) << refused;
        });
}

TEST_F(CIMServiceConfigTest, AnswersOneWithSigchldIgnoredAlthoughTheSetRan) {
    addCommand("exit 0");
    test::isolated([&] {
        std::signal(SIGCHLD, SIG_IGN);
        EXPECT_EQ(CIMServiceConfig().setIntervalParameter("30"), 1U);
        EXPECT_THAT(commands.take(), testing::SizeIs(1));
    });
}

TEST_F(CIMServiceConfigTest, ReadsTheFirstLineOfTheOutput) {
    const struct {
        const char* script;
        unsigned int value;
    } table[] = {
        {"echo 'Current value: 20'", 20},
        {"echo 'Current value:20'", 20},
        {"echo 'Current value:   0030 seconds'", 30},
        {"echo 'a: 1: 2'", 1},
        {"echo 42", 42},
        {"echo ' 42 attempts'", 42},
        {"printf 'Current value: 20'", 20},
        {"echo 'Current value: -5'", 4294967291},
        {"echo 'Current value: 4294967295'", 4294967295},
        {"echo 'Current value: 20'; exit 1", 20},
        {"printf 'Current value: 20\\nCurrent value: 30\\n'", 20},
        {"printf '\\nCurrent value: 20\\n'", 0},
        {"echo 'Current value: 20' >&2", 0},
        {"echo 'Current value:'", 0},
        {"echo 'Current value: twenty'", 0},
        {"echo 'Current value can not be determined because the CIM server is not running.'; exit 1", 0},
        {"echo", 0},
        {"exit 0", 0},
        {"exit 127", 0},
        {"printf 'Current value: %0239d7%s\\n' 0 8", 7}, // the 255 bytes that are read end behind the 7
        {"printf '%0300d: 5\\n' 6", 0},                  // the colon stands beyond them
    };
    for (const auto& row : table) {
        addCommand(row.script);
        test::isolated([&] {
            unsigned int value = 12345;
            EXPECT_TRUE(CIMServiceConfig().getIntervalParameter(value)) << row.script;
            EXPECT_EQ(value, row.value) << row.script;
            value = 12345;
            EXPECT_TRUE(CIMServiceConfig().getAttemptParameter(value)) << row.script;
            EXPECT_EQ(value, row.value) << row.script;
        });
    }
}

TEST_F(CIMServiceConfigTest, GetsWithTwoBlanksBeforeTheOption) {
    addCommand("echo 'Current value: 20'");
    test::isolated([&] {
        unsigned int value = 0;
        CIMServiceConfig().getIntervalParameter(value);
        CIMServiceConfig().getAttemptParameter(value);
        EXPECT_THAT(test::takeShellCalls(), ElementsAre("popen r: " + command() + "  -g " + intervalProperty,
                                                        "popen r: " + command() + "  -g " + attemptsProperty));
        EXPECT_THAT(commands.take(), ElementsAre("product/vcm/bin/cimconfig [-g] [" + intervalProperty + "]",
                                                 "product/vcm/bin/cimconfig [-g] [" + attemptsProperty + "]"));
    });
}

TEST_F(CIMServiceConfigTest, AnswersFalseOnlyWhenTheGetCannotBeStarted) {
    test::isolated([] {
        unsigned int value = 12345;
        test::refuseToStart("cimconfig");
        EXPECT_FALSE(CIMServiceConfig().getIntervalParameter(value));
        EXPECT_FALSE(CIMServiceConfig().getAttemptParameter(value));
        EXPECT_EQ(value, 12345U);
        test::refuseToStart("");
        EXPECT_TRUE(CIMServiceConfig().getIntervalParameter(value)) << "the shell runs also without the command";
        EXPECT_EQ(value, 0U);
    });
}

TEST_F(CIMServiceConfigTest, UsesTheSystemsDirectoryOnAKvmGuest) {
    test::isolated([&] {
        host("/opt/vk/platform/", true);
        test::refuseToStart("cimconfig"); // the real one, where there is one, is not to run
        CIMServiceConfig config;
        unsigned int value = 0;
        config.setAttemptParameter("5");
        config.getAttemptParameter(value);
        EXPECT_THAT(test::takeShellCalls(), ElementsAre("system: /usr/sbin/cimconfig -s " + attemptsProperty + "=5 -p",
                                                        "popen r: /usr/sbin/cimconfig  -g " + attemptsProperty));
    });
}

TEST_F(CIMServiceConfigTest, AsksForTheDirectoryAlsoOnAKvmGuest) {
    test::isolated([&] {
        host("/opt/vk/platform/", true);
        test::refuseToStart("cimconfig");
        test::takeLog();
        CIMServiceConfig().setAttemptParameter("5");
        EXPECT_THAT(test::takeLog(), Contains(ContainsRegex(" LOG 4000 .* getbinDirectory: ENTERING: ")));
    });
}

TEST_F(CIMServiceConfigTest, RunsTheSetterThatARequestNames) {
    addCommand("exit 0");
    test::isolated([&] {
        CIMServiceConfig config;
        std::string interval = "deliveryRetryIntervalSec=30";
        EXPECT_EQ(config.executeCIMServiceConfig(interval), 0U);
        std::string attempts = "deliveryRetryAttempts=5";
        EXPECT_EQ(config.executeCIMServiceConfig(attempts), 0U);
        std::string withEquals = "deliveryRetryAttempts=5=6";
        EXPECT_EQ(config.executeCIMServiceConfig(withEquals), 0U);
        EXPECT_THAT(commands.take(), ElementsAre("product/vcm/bin/cimconfig [-s] [" + intervalProperty + "=30] [-p]",
                                                 "product/vcm/bin/cimconfig [-s] [" + attemptsProperty + "=5] [-p]",
                                                 "product/vcm/bin/cimconfig [-s] [" + attemptsProperty + "=5=6] [-p]"));
    });
}

TEST_F(CIMServiceConfigTest, RunsNothingForOtherRequests) {
    addCommand("exit 0");
    test::takeShellCalls();
    for (std::string request :
         {"DeliveryRetryAttempts=5", "deliveryRetryAttempts", "deliveryRetryAttempts =5", " deliveryRetryAttempts=5",
          "deliveryRetryIntervalsec=5", "deliveryRetryInterval=5", "=5", "="})
        EXPECT_EQ(CIMServiceConfig().executeCIMServiceConfig(request), 1U) << request;
    std::string empty;
    EXPECT_EQ(CIMServiceConfig().executeCIMServiceConfig(empty), 1U);
    EXPECT_THAT(test::takeShellCalls(), IsEmpty());
}

} // namespace
