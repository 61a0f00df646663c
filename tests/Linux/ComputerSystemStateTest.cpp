// The state of a computer: health, operational and enabled state, purpose.

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

TEST(ComputerSystem, AppendsTheOperationalStatusToWhatTheCallerHas) {
    const std::pair<unsigned, Numbers> expected[] = {{0, {9, 0}}, {1, {9, 2, 11}}, {20, {9, 3, 5}}, {21, {9, 3}}};
    for (const auto& [status, wanted] : expected) {
        test::simulateOne([status = status](test::Node& node) { node.status = status; });
        Numbers states = {9};
        EXPECT_TRUE(ComputerSystem().getOperationalStatus(states));
        EXPECT_EQ(states, wanted) << "status " << status;
    }
}

TEST(ComputerSystem, TellsTheEnabledStateFromThePowerStateAndLeavesItForOthers) {
    const std::pair<unsigned, unsigned short> expected[] = {{0, 0},  {1, 2},   {16, 4},  {7, 77},
                                                            {2, 77}, {15, 77}, {17, 77}, {4294967295U, 77}};
    for (const auto& [powerState, enabledState] : expected) {
        test::simulateOne([power = powerState](test::Node& node) { node.properties[123] = power; });
        unsigned short state = 77;
        EXPECT_TRUE(ComputerSystem().getEnabledState(state));
        EXPECT_EQ(state, enabledState) << "power state " << powerState;
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
