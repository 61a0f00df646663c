#include "Linux/ComputerSystem.h"
#include "Linux/OneComputer.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <string>
#include <vector>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using VK::BaseServerProvider::ComputerSystem;
using Filter = ComputerSystem::FilterType;
using Texts = std::vector<std::string>;
using Numbers = std::vector<unsigned short>;

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

TEST(ComputerSystem, BecomesFalseForANameThatNoNodeHas) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    ComputerSystem system;
    system.setFilter(Filter::Name, "x");
    EXPECT_FALSE(static_cast<bool>(system));
}

TEST(ComputerSystem, ComparesNamesByteForByte) {
    test::simulate({test::computer(0, "node7")});
    for (const char* other : {"Node7", "node", "node77", "node7 ", " node7", ""}) {
        ComputerSystem system;
        system.setFilter(Filter::Name, other);
        EXPECT_FALSE(static_cast<bool>(system)) << "'" << other << "'";
    }
    ComputerSystem system;
    system.setFilter(Filter::Name, "node7");
    EXPECT_TRUE(static_cast<bool>(system));
}

TEST(ComputerSystem, DoesNotTakeANameForAnotherThatGoesOnBehindAZeroByte) {
    test::simulate({test::computer(0, "node7")});
    ComputerSystem system;
    system.setFilter(Filter::Name, std::string("node7\0x", 7));
    EXPECT_FALSE(static_cast<bool>(system));
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
    system.setFilter(Filter::Name, "node7");
    EXPECT_TRUE(system.evaluate());
    system.setFilter(Filter::Name, "node8");
    EXPECT_FALSE(static_cast<bool>(system));
}

TEST(ComputerSystem, EvaluatesToTrueWithoutFilters) {
    test::simulate({test::computer(0, "node7")});
    EXPECT_TRUE(ComputerSystem().evaluate());
}

TEST(ComputerSystem, TracesTheFilterItIsGiven) {
    test::simulate({test::computer(0, "node7")});
    ComputerSystem system;
    test::takeLog();
    system.setFilter(Filter::Name, "node7");
    const Texts lines = test::withoutPlaces(test::takeLog());
    ASSERT_FALSE(lines.empty());
    EXPECT_EQ(lines.front(), "LOG 4000 Norvane.BaseServerProvider ComputerSystem setFilter: ENTERING: setFilter() in "
                             "ComputerSystem [Line],Parameters List:  filterType=0 reference=node7");
}

TEST(ComputerSystem, ReadsItsTexts) {
    test::simulateOne([](test::Node& node) {
        node.properties[115] = "ops@example.org";
        node.properties[116] = "Operations";
    });
    const ComputerSystem system;
    std::string text;
    EXPECT_TRUE(system.getName(text));
    EXPECT_EQ(text, "node7");
    EXPECT_TRUE(system.getElementName(text));
    EXPECT_EQ(text, "node7");
    EXPECT_TRUE(system.getUUID(text));
    EXPECT_EQ(text, "4c4c4544-0043-3010-8052-000000000000");
    EXPECT_TRUE(system.getPrimaryOwnerContact(text));
    EXPECT_EQ(text, "ops@example.org");
    EXPECT_TRUE(system.getPrimaryOwnerName(text));
    EXPECT_EQ(text, "Operations");
    EXPECT_TRUE(system.getDescription(text));
    EXPECT_EQ(text, "Rack server 0");
    EXPECT_TRUE(system.getCreationClassName(text));
    EXPECT_EQ(text, "VESKA_ComputerSystem");
}

TEST(ComputerSystem, SuppliesNoTextThatTheNodeLacks) {
    test::simulateOne([](test::Node& node) { node.properties.clear(); });
    const ComputerSystem system;
    std::string text = "before";
    EXPECT_FALSE(system.getName(text));
    EXPECT_FALSE(system.getElementName(text));
    EXPECT_FALSE(system.getUUID(text));
    EXPECT_FALSE(system.getPrimaryOwnerContact(text));
    EXPECT_FALSE(system.getPrimaryOwnerName(text));
    EXPECT_EQ(text, "before");
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
    EXPECT_TRUE(system.getOtherIdentifyingInfo(values));
    EXPECT_TRUE(system.getIdentifyingDescriptions(descriptions));
    EXPECT_EQ(values.size(), 6U);
    EXPECT_EQ(values.front(), "4c4c4544-0043-3010-8052-000000000000");
    EXPECT_EQ(descriptions.size(), 6U);
    EXPECT_EQ(descriptions.front(), "CIM:GUID");
}

/// Asks a getter that never has a value.
template <class Value>
void expectUntouched(const ComputerSystem& system, bool (ComputerSystem::*getter)(Value&) const, const Value& before) {
    Value value = before;
    EXPECT_FALSE((system.*getter)(value));
    EXPECT_EQ(value, before);
}

TEST(ComputerSystem, LeavesTheOutputOfWhatTheHostCannotSupply) {
    test::simulateOne([](test::Node&) {});
    const ComputerSystem system;
    for (const auto getter :
         {&ComputerSystem::getCaption, &ComputerSystem::getInstallDate, &ComputerSystem::getOtherEnabledState,
          &ComputerSystem::getTimeOfLastStateChange, &ComputerSystem::getNameFormat})
        expectUntouched(system, getter, std::string("before"));
    for (const auto getter : {&ComputerSystem::getPrimaryStatus, &ComputerSystem::getDetailedStatus,
                              &ComputerSystem::getOperatingStatus, &ComputerSystem::getCommunicationStatus,
                              &ComputerSystem::getRequestedState, &ComputerSystem::getEnabledDefault,
                              &ComputerSystem::getTransitioningToState, &ComputerSystem::getResetCapability})
        expectUntouched(system, getter, static_cast<unsigned short>(77));
    for (const auto getter : {&ComputerSystem::getStatusDescriptions, &ComputerSystem::getRoles,
                              &ComputerSystem::getOtherDedicatedDescriptions})
        expectUntouched(system, getter, Texts{"before"});
    expectUntouched(system, &ComputerSystem::getAvailableRequestedStates, Numbers{77});
}

/// How often a step asks whether a node passes.
long questionsOfAStep(ComputerSystem& system) {
    test::takeLog();
    ++system;
    const std::vector<std::string> lines = test::takeLog();
    return std::count_if(lines.begin(), lines.end(), [](const std::string& line) {
        return line.find(" LOG ") != std::string::npos && line.find("ENTERING: evaluate()") != std::string::npos;
    });
}

TEST(ComputerSystem, AsksWhetherANodePassesAtEveryStepAlsoWithoutFilters) {
    simulateThree();
    ComputerSystem unfiltered;
    EXPECT_EQ(questionsOfAStep(unfiltered), 1);
    EXPECT_EQ(questionsOfAStep(unfiltered), 1);
    EXPECT_EQ(questionsOfAStep(unfiltered), 0) << "past the end there is nothing to ask of";
    ComputerSystem filtered;
    filtered.setFilter(Filter::Name, "node7");
    EXPECT_EQ(questionsOfAStep(filtered), 1) << "the nameless one passes";
    EXPECT_EQ(questionsOfAStep(filtered), 1) << "node8 does not";
    EXPECT_FALSE(static_cast<bool>(filtered));
}

TEST(ComputerSystem, WritesNoLineForWhatTheHostCannotSupply) {
    simulateThree();
    const ComputerSystem system;
    test::takeLog();
    std::string text;
    unsigned short number = 0;
    Texts texts;
    Numbers numbers;
    EXPECT_FALSE(system.getCaption(text) || system.getInstallDate(text) || system.getOtherEnabledState(text) ||
                 system.getTimeOfLastStateChange(text) || system.getNameFormat(text));
    EXPECT_FALSE(system.getPrimaryStatus(number) || system.getDetailedStatus(number) ||
                 system.getOperatingStatus(number) || system.getCommunicationStatus(number) ||
                 system.getRequestedState(number) || system.getEnabledDefault(number) ||
                 system.getTransitioningToState(number) || system.getResetCapability(number));
    EXPECT_FALSE(system.getStatusDescriptions(texts) || system.getRoles(texts) ||
                 system.getOtherDedicatedDescriptions(texts) || system.getAvailableRequestedStates(numbers));
    EXPECT_THAT(test::takeLog(), IsEmpty());
}

} // namespace
