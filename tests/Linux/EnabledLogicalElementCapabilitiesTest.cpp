#include "Linux/EnabledLogicalElementCapabilities.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using VK::BaseServerProvider::EnabledLogicalElementCapabilities;

std::vector<std::string> instanceIDs(EnabledLogicalElementCapabilities& capabilities) {
    std::vector<std::string> found;
    for (; capabilities; ++capabilities) {
        std::string id;
        EXPECT_TRUE(capabilities.getInstanceID(id));
        found.push_back(id);
    }
    return found;
}

TEST(EnabledLogicalElementCapabilities, AreOneForEachComputerNamedByItsPath) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::computer(1, "b")});
    EnabledLogicalElementCapabilities capabilities;
    EXPECT_THAT(instanceIDs(capabilities), testing::ElementsAre("/computer/0", "/computer/1"));
}

TEST(EnabledLogicalElementCapabilities, StayOnTheNodeWhoseInstanceIDTheFilterNames) {
    test::simulate({test::computer(0, "node7")});
    EnabledLogicalElementCapabilities named;
    named.setFilter(EnabledLogicalElementCapabilities::FilterType::InstanceID, "/computer/0");
    EXPECT_TRUE(named);
    for (const char* other : {"", "/computer", "/computer/00", "/COMPUTER/0", "/computer/0/"}) {
        EnabledLogicalElementCapabilities unnamed;
        unnamed.setFilter(EnabledLogicalElementCapabilities::FilterType::InstanceID, other);
        EXPECT_FALSE(unnamed) << other;
    }
}

TEST(EnabledLogicalElementCapabilities, LetAFilterOfAnotherTypePass) {
    test::simulate({test::computer(0, "node7")});
    EnabledLogicalElementCapabilities capabilities;
    capabilities.setFilter(static_cast<EnabledLogicalElementCapabilities::FilterType>(1), "no such thing");
    EXPECT_TRUE(capabilities);
}

TEST(EnabledLogicalElementCapabilities, AllowEditingTheNameExactlyWhereItCanBeWritten) {
    test::Node node = test::computer(0, "node7");
    bool supported = true;
    node.readOnly = {108};
    test::simulate({node});
    EXPECT_TRUE(EnabledLogicalElementCapabilities().getElementNameEditSupported(supported));
    EXPECT_FALSE(supported);

    node.readOnly = {};
    test::simulate({node});
    EXPECT_TRUE(EnabledLogicalElementCapabilities().getElementNameEditSupported(supported));
    EXPECT_TRUE(supported);
}

TEST(EnabledLogicalElementCapabilities, DoNotSayWhetherTheNameCanBeEditedWhereTheHostDoesNot) {
    test::Node node = test::computer(0, "node7");
    node.unanswerable = {108};
    test::simulate({node});
    bool supported = true;
    EXPECT_FALSE(EnabledLogicalElementCapabilities().getElementNameEditSupported(supported));
    EXPECT_TRUE(supported);
}

TEST(EnabledLogicalElementCapabilities, BearTheComputersName) {
    test::Node nameless = test::computer(1, "");
    nameless.properties.erase(108);
    test::simulate({test::computer(0, "node7"), nameless});
    EnabledLogicalElementCapabilities capabilities;
    std::string name;
    EXPECT_TRUE(capabilities.getElementName(name));
    EXPECT_EQ(name, "node7");
    ++capabilities;
    EXPECT_FALSE(capabilities.getElementName(name));
}

TEST(EnabledLogicalElementCapabilities, SupplyNothingElse) {
    test::simulate({test::computer(0, "node7")});
    const EnabledLogicalElementCapabilities capabilities;
    unsigned short length = 7;
    std::vector<unsigned short> states = {7};
    std::string mask = "untouched";
    EXPECT_FALSE(capabilities.getMaxElementNameLen(length));
    EXPECT_FALSE(capabilities.getRequestedStatesSupported(states));
    EXPECT_FALSE(capabilities.getElementNameMask(mask));
    EXPECT_FALSE(capabilities.getStateAwareness(states));
    EXPECT_EQ(length, 7);
    EXPECT_THAT(states, testing::ElementsAre(7));
    EXPECT_EQ(mask, "untouched");
}

} // namespace
