// What a computer tells of how it is: health, operational and enabled state, purpose.

#include "Linux/ComputerSystem.h"
#include "Linux/OneComputer.h"

#include <gmock/gmock.h>

#include <string>
#include <vector>

namespace {

using testing::ElementsAre;
using VK::BaseServerProvider::ComputerSystem;
using Numbers = std::vector<unsigned short>;

TEST(ComputerSystem, TellsHealthFromTheNodeStatus) {
    for (unsigned status = 0; status <= 30; ++status) {
        test::simulateOne([&](test::Node& node) { node.status = status; });
        unsigned short health = 0;
        std::string text;
        Numbers states;
        Numbers expectedStates = {0};
        std::string expectedText = "Unknown";
        unsigned short expectedHealth = 0;
        if (status == 1) {
            expectedStates = {2, 11};
            expectedText = "OK";
            expectedHealth = 5;
        } else if (status == 20) {
            expectedStates = {3, 5};
            expectedText = "Pred Fail";
            expectedHealth = 10;
        } else if (status >= 21 && status <= 26) {
            expectedStates = {3};
            expectedText = "Degraded";
            expectedHealth = 10;
        }
        const ComputerSystem system;
        EXPECT_TRUE(system.getHealthState(health) && system.getStatus(text) && system.getOperationalStatus(states));
        EXPECT_EQ(health, expectedHealth) << "status " << status;
        EXPECT_EQ(text, expectedText) << "status " << status;
        EXPECT_EQ(states, expectedStates) << "status " << status;
    }
}

TEST(ComputerSystem, TellsAPredictiveFailure) {
    test::simulateOne([](test::Node& node) { node.status = 20; });
    const ComputerSystem system;
    unsigned short health = 0;
    std::string text;
    Numbers states;
    EXPECT_TRUE(system.getHealthState(health) && system.getStatus(text) && system.getOperationalStatus(states));
    EXPECT_EQ(health, 10);
    EXPECT_EQ(text, "Pred Fail");
    EXPECT_THAT(states, ElementsAre(3, 5));
}

TEST(ComputerSystem, AppendsTheOperationalStatusToWhatTheCallerHas) {
    const std::pair<unsigned, Numbers> expected[] = {{0, {9, 0}}, {1, {9, 2, 11}}, {20, {9, 3, 5}}, {21, {9, 3}}};
    for (const auto& [status, wanted] : expected) {
        test::simulateOne([status = status](test::Node& node) { node.status = status; });
        Numbers states = {9};
        EXPECT_TRUE(ComputerSystem().getOperationalStatus(states));
        EXPECT_EQ(states, wanted) << "status " << status;
    }
}

TEST(ComputerSystem, TellsTheEnabledStateFromThePowerState) {
    struct Case {
        unsigned powerState;
        unsigned short enabledState;
    };
    for (const Case expected : {Case{0, 0}, Case{1, 2}, Case{16, 4}}) {
        test::simulateOne([&](test::Node& node) { node.properties[123] = expected.powerState; });
        unsigned short state = 77;
        EXPECT_TRUE(ComputerSystem().getEnabledState(state));
        EXPECT_EQ(state, expected.enabledState) << "power state " << expected.powerState;
    }
}

TEST(ComputerSystem, SuppliesTheEnabledStateUnchangedForOtherPowerStates) {
    for (const unsigned powerState : {7U, 2U, 15U, 17U, 4294967295U}) {
        test::simulateOne([&](test::Node& node) { node.properties[123] = powerState; });
        unsigned short state = 77;
        EXPECT_TRUE(ComputerSystem().getEnabledState(state)) << "power state " << powerState;
        EXPECT_EQ(state, 77) << "power state " << powerState;
    }
}

TEST(ComputerSystem, SuppliesNoEnabledStateWithoutAPowerState) {
    unsigned short state = 77;
    test::simulateOne([](test::Node& node) { node.properties.erase(123); });
    EXPECT_FALSE(ComputerSystem().getEnabledState(state));
    test::simulateOne([](test::Node& node) { node.properties[123] = "1"; });
    EXPECT_FALSE(ComputerSystem().getEnabledState(state));
    EXPECT_EQ(state, 77);
}

TEST(ComputerSystem, IsNotDedicatedToAnything) {
    test::simulateOne([](test::Node&) {});
    Numbers purposes = {4, 5};
    EXPECT_TRUE(ComputerSystem().getDedicated(purposes));
    EXPECT_THAT(purposes, ElementsAre(0));
}

} // namespace
