#include "Linux/ComputerSystem.h"
#include "Linux/OneComputer.h"
#include "Linux/Untouched.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <string>
#include <vector>

namespace {

using namespace std::string_literals;
using test::expectUntouched;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::IsSupersetOf;
using VK::BaseServerProvider::ComputerSystem;
using Filter = ComputerSystem::FilterType;
using Texts = std::vector<std::string>;

Texts remainingNames(ComputerSystem& system) {
    Texts names;
    for (; system; ++system) {
        std::string name = "(none)";
        static_cast<void>(system.getName(name));
        names.push_back(name);
    }
    return names;
}

void simulateThree() {
    test::Node nameless = test::computer(1, "");
    nameless.properties.erase(108);
    test::simulate({test::computer(0, "node7"), nameless, test::computer(2, "node8")});
}

TEST(ComputerSystem, WalksTheComputersOfTheTreeAndNoOtherNodes) {
    test::simulate({test::chassis(0, 0, "CZ1"), test::computer(0, "node7"), test::computer(1, "node8")});
    ComputerSystem system;
    EXPECT_THAT(remainingNames(system), ElementsAre("node7", "node8"));
    EXPECT_FALSE(static_cast<bool>(++system)) << "past the end it stays past the end";
}

TEST(ComputerSystem, StandsOnNothingWithoutAComputer) {
    test::simulate({test::chassis(0, 0, "CZ1")});
    EXPECT_FALSE(static_cast<bool>(ComputerSystem()));
}

TEST(ComputerSystem, KnowsNothingWhereItStandsOnNothing) {
    test::simulate({});
    const ComputerSystem system;
    std::string text = "before";
    unsigned short number = 77;
    EXPECT_FALSE(system.getName(text));
    EXPECT_FALSE(system.getUUID(text));
    EXPECT_FALSE(system.getEnabledState(number));
    EXPECT_EQ(text, "before");
    EXPECT_EQ(number, 77);
    EXPECT_TRUE(system.getHealthState(number));
    EXPECT_EQ(number, 0);
    EXPECT_TRUE(system.getDescription(text));
    EXPECT_EQ(text, "");
}

TEST(ComputerSystem, ComparesNamesByteForByte) {
    test::simulate({test::computer(0, "node7")});
    for (const std::string& other : {"x"s, "Node7"s, "node"s, "node77"s, "node7 "s, " node7"s, ""s, "node7\0x"s}) {
        ComputerSystem system;
        system.setFilter(Filter::Name, other);
        EXPECT_FALSE(static_cast<bool>(system)) << "'" << other << "'";
    }
    ComputerSystem system;
    system.setFilter(Filter::Name, "node7");
    EXPECT_TRUE(static_cast<bool>(system));
}

TEST(ComputerSystem, LetsAComputerWithoutANamePassTheFilter) {
    simulateThree();
    ComputerSystem system;
    system.setFilter(Filter::Name, "node8");
    EXPECT_THAT(remainingNames(system), ElementsAre("(none)", "node8"));
}

TEST(ComputerSystem, LetsEveryNodePassAFilterOfAnotherType) {
    simulateThree();
    ComputerSystem system;
    system.setFilter(static_cast<Filter>(1), "x");
    EXPECT_THAT(remainingNames(system), ElementsAre("node7", "(none)", "node8"));
}

TEST(ComputerSystem, OnlyNarrowsWhatLiesAhead) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8"), test::computer(2, "node7")});
    ComputerSystem system;
    ++system;
    system.setFilter(Filter::Name, "node7");
    EXPECT_THAT(remainingNames(system), ElementsAre("node7"));
}

TEST(ComputerSystem, WantsEveryFilterToPass) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    ComputerSystem system;
    EXPECT_TRUE(system.evaluate()) << "without filters";
    system.setFilter(Filter::Name, "node7");
    EXPECT_TRUE(system.evaluate());
    system.setFilter(Filter::Name, "node8");
    EXPECT_FALSE(static_cast<bool>(system));
}

using TextGetter = bool (ComputerSystem::*)(std::string&) const;

TEST(ComputerSystem, ReadsItsTexts) {
    test::simulateOne([](test::Node& node) {
        node.properties[115] = "ops@example.org";
        node.properties[116] = "Operations";
    });
    const std::pair<TextGetter, const char*> texts[] = {
        {&ComputerSystem::getName, "node7"},
        {&ComputerSystem::getElementName, "node7"},
        {&ComputerSystem::getUUID, "4c4c4544-0043-3010-8052-000000000000"},
        {&ComputerSystem::getPrimaryOwnerContact, "ops@example.org"},
        {&ComputerSystem::getPrimaryOwnerName, "Operations"},
        {&ComputerSystem::getDescription, "Rack server 0"},
        {&ComputerSystem::getCreationClassName, "VESKA_ComputerSystem"},
    };
    for (const auto& [getter, expected] : texts) {
        std::string text;
        EXPECT_TRUE((ComputerSystem().*getter)(text));
        EXPECT_EQ(text, expected);
    }
}

TEST(ComputerSystem, IdentifiesItselfPairByPair) {
    test::simulateOne([](test::Node&) {});
    Texts descriptions;
    Texts values;
    EXPECT_TRUE(ComputerSystem().getIdentifyingInfo(descriptions, values));
    EXPECT_THAT(values,
                ElementsAre("4c4c4544-0043-3010-8052-000000000000", "uid-1", "Model 0:SYS0", "SYS0", "x86_64", "true"));
    EXPECT_THAT(descriptions, ElementsAre("CIM:GUID", "CIM:UniqueSystemID", "CIM:Model:SerialNumber", "CIM:Tag",
                                          "CIM:Architecture", "CIM:SecureIndicationEnabled"));
}

TEST(ComputerSystem, FillsWhatIdentifiesItButAnswersFalseWithoutAChassis) {
    test::simulate({test::computer(0, "node7")});
    Texts descriptions;
    Texts values;
    const ComputerSystem system;
    EXPECT_FALSE(system.getIdentifyingInfo(descriptions, values));
    EXPECT_THAT(values, ElementsAre("4c4c4544-0043-3010-8052-000000000000", "uid-1", "x86_64", "true"));
    EXPECT_THAT(descriptions,
                ElementsAre("CIM:GUID", "CIM:UniqueSystemID", "CIM:Architecture", "CIM:SecureIndicationEnabled"));
    EXPECT_FALSE(system.getOtherIdentifyingInfo(values));
    EXPECT_FALSE(system.getIdentifyingDescriptions(descriptions));
}

TEST(ComputerSystem, LeavesOutOnlyTheGuidPairsWithoutAUuid) {
    test::simulateOne([](test::Node& node) { node.properties.erase(64); });
    Texts descriptions;
    Texts values;
    EXPECT_TRUE(ComputerSystem().getIdentifyingInfo(descriptions, values));
    EXPECT_THAT(values, ElementsAre("Model 0:SYS0", "SYS0", "x86_64", "true"));
    EXPECT_THAT(descriptions,
                ElementsAre("CIM:Model:SerialNumber", "CIM:Tag", "CIM:Architecture", "CIM:SecureIndicationEnabled"));
}

TEST(ComputerSystem, LeavesOutTheModelPairsWithoutSerialNumberOrModelOfItsOwn) {
    for (const unsigned missing : {50U, 39U}) {
        test::simulateOne([&](test::Node& node) { node.properties.erase(missing); });
        Texts descriptions;
        Texts values;
        EXPECT_TRUE(ComputerSystem().getIdentifyingInfo(descriptions, values)) << "the chassis alone decides";
        EXPECT_THAT(descriptions,
                    ElementsAre("CIM:GUID", "CIM:UniqueSystemID", "CIM:Architecture", "CIM:SecureIndicationEnabled"));
        EXPECT_EQ(values.size(), descriptions.size());
    }
}

TEST(ComputerSystem, AppendsWhatIdentifiesItAndClearsBeforeEitherHalf) {
    test::simulateOne([](test::Node&) {});
    const ComputerSystem system;
    Texts values = {"mine"};
    Texts descriptions = {"mine"};
    EXPECT_TRUE(system.getIdentifyingInfo(descriptions, values));
    EXPECT_EQ(values.size(), 7U);
    EXPECT_EQ(values.front(), "mine");
    test::takeLog();
    EXPECT_TRUE(system.getOtherIdentifyingInfo(values));
    EXPECT_TRUE(system.getIdentifyingDescriptions(descriptions));
    EXPECT_THAT(test::takeLog(), IsSupersetOf({HasSubstr(" getOtherIdentifyingInfo: ENTERING: "),
                                               HasSubstr(" getIdentifyingDescriptions: ENTERING: ")}));
    EXPECT_EQ(values.size(), 6U);
    EXPECT_EQ(values.front(), "4c4c4544-0043-3010-8052-000000000000");
    EXPECT_EQ(descriptions.size(), 6U);
    EXPECT_EQ(descriptions.front(), "CIM:GUID");
}

TEST(ComputerSystem, SuppliesNoTextThatTheNodeLacks) {
    test::simulateOne([](test::Node& node) { node.properties.clear(); });
    expectUntouched(ComputerSystem(), &ComputerSystem::getName, &ComputerSystem::getElementName,
                    &ComputerSystem::getUUID, &ComputerSystem::getPrimaryOwnerContact,
                    &ComputerSystem::getPrimaryOwnerName);
}

TEST(ComputerSystem, LeavesTheOutputOfWhatTheHostCannotSupply) {
    test::simulateOne([](test::Node&) {});
    expectUntouched(ComputerSystem(), &ComputerSystem::getCaption, &ComputerSystem::getInstallDate,
                    &ComputerSystem::getOtherEnabledState, &ComputerSystem::getTimeOfLastStateChange,
                    &ComputerSystem::getNameFormat, &ComputerSystem::getPrimaryStatus,
                    &ComputerSystem::getDetailedStatus, &ComputerSystem::getOperatingStatus,
                    &ComputerSystem::getCommunicationStatus, &ComputerSystem::getRequestedState,
                    &ComputerSystem::getEnabledDefault, &ComputerSystem::getTransitioningToState,
                    &ComputerSystem::getResetCapability, &ComputerSystem::getStatusDescriptions,
                    &ComputerSystem::getRoles, &ComputerSystem::getOtherDedicatedDescriptions,
                    &ComputerSystem::getAvailableRequestedStates);
}

TEST(ComputerSystem, MakesNoIdentifyingTextsForAnInstanceWithoutAChassisAndHandsThemToADirectCaller) {
    test::simulate({test::computer(0, "node7")});
    const ComputerSystem system;
    Texts texts = {"before"};
    EXPECT_FALSE(system.supplyOtherIdentifyingInfo(texts));
    EXPECT_THAT(texts, IsEmpty());
    texts = {"before"};
    EXPECT_FALSE(system.supplyIdentifyingDescriptions(texts));
    EXPECT_THAT(texts, IsEmpty());
    EXPECT_FALSE(system.getOtherIdentifyingInfo(texts));
    EXPECT_THAT(texts, testing::SizeIs(6 - 2)) << "all but those of a chassis";
}

TEST(ComputerSystem, IdentifiesEachComputerItStandsOnByItsOwnTexts) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8"), test::chassis(0, 0, "CZ1")});
    ComputerSystem system;
    const auto uuid = [&system] {
        Texts texts;
        return system.getOtherIdentifyingInfo(texts) ? texts.at(0) : "no chassis";
    };
    EXPECT_EQ(uuid(), "4c4c4544-0043-3010-8052-000000000000");
    ++system;
    EXPECT_EQ(uuid(), "4c4c4544-0043-3010-8052-000000000001");
    system.initialize();
    EXPECT_EQ(uuid(), "4c4c4544-0043-3010-8052-000000000000");
    system.setFilter(Filter::Name, "node8");
    EXPECT_EQ(uuid(), "4c4c4544-0043-3010-8052-000000000001");
}

} // namespace
