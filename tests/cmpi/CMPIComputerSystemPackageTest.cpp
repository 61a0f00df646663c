#include "cmpi/CMPIComputerSystemPackage.h"
#include "support/Associations.h"
#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr char className[] = "VESKA_ComputerSystemPackage";

om::ObjectPath computerPath(const std::string& name) {
    return test::path("VESKA_ComputerSystem", {{"Name", name}});
}

om::ObjectPath chassisPath(const std::string& tag) {
    return test::path("VESKA_PhysicalPackage", {{"Tag", tag}});
}

om::ObjectPath association(const std::string& tag, const std::string& name) {
    return test::associationPath(className, {{"Antecedent", chassisPath(tag)}, {"Dependent", computerPath(name)}});
}

std::vector<std::string> namedEnds() {
    const om::Answer names = test::names(className);
    EXPECT_EQ(test::ends(test::pathsOfInstances(test::instances(className))), test::ends(test::paths(names)));
    EXPECT_FALSE(names.done); // on purpose: neither enumeration of this class is closed
    EXPECT_EQ(names.code, CMPI_RC_OK);
    return test::ends(test::paths(names));
}

TEST(CMPIComputerSystemPackage, PairsOneChassisWithItsComputer) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")});
    EXPECT_THAT(namedEnds(), ElementsAre("Antecedent=A -> Dependent=a"));
}

TEST(CMPIComputerSystemPackage, PairsEveryChassisWithItsOwnComputer) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::chassis(0, 1, "B"), test::computer(1, "b"),
                    test::chassis(1, 0, "C")});
    EXPECT_THAT(namedEnds(), ElementsAre("Antecedent=A -> Dependent=a", "Antecedent=B -> Dependent=a",
                                         "Antecedent=C -> Dependent=b"));
}

TEST(CMPIComputerSystemPackage, PassesOverComputersWithoutChassis) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b"), test::chassis(1, 0, "B"), test::computer(2, "c"),
                    test::computer(3, "d"), test::chassis(3, 0, "D")});
    EXPECT_THAT(namedEnds(), ElementsAre("Antecedent=B -> Dependent=b", "Antecedent=D -> Dependent=d"));
    test::simulate({test::computer(0, "a")});
    EXPECT_THAT(namedEnds(), IsEmpty());
}

TEST(CMPIComputerSystemPackage, IsNotFoundOnAHostWithoutComputer) {
    test::simulate({test::chassis(0, 0, "A")});
    test::takeLog();
    EXPECT_THAT(namedEnds(), IsEmpty());
    EXPECT_THAT(test::takeLog(), Contains(HasSubstr("]: Could not find instance")));
}

TEST(CMPIComputerSystemPackage, PairsAChassisWithoutSerialNumberByItsClassAlone) {
    test::simulate({test::computer(0, "a"), test::without(test::chassis(0, 0, ""), 50), test::chassis(0, 1, "B")});
    EXPECT_THAT(namedEnds(),
                ElementsAre("Antecedent=VESKA_PhysicalPackage -> Dependent=a", "Antecedent=B -> Dependent=a"));
}

TEST(CMPIComputerSystemPackage, CarriesThePlatformGUIDOfTheFirstComputerEverywhere) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b"), test::chassis(1, 0, "B")});
    const om::Instance instance = test::instancesOf(test::instances(className))[0];
    ASSERT_THAT(test::namesOf(instance.properties), ElementsAre("Antecedent", "Dependent", "PlatformGUID"));
    EXPECT_EQ(test::text(instance.properties[2].second), "4c4c4544-0043-3010-8052-000000000000");
}

TEST(CMPIComputerSystemPackage, HasNoPlatformGUIDWithoutAUUID) {
    test::simulate({test::without(test::computer(0, "a"), 64), test::chassis(0, 0, "A")});
    EXPECT_THAT(test::namesOf(test::instancesOf(test::instances(className))[0].properties),
                ElementsAre("Antecedent", "Dependent"));
}

TEST(CMPIComputerSystemPackage, GivesExactlyTheInstanceThatIsNamed) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::chassis(0, 1, "B")});
    EXPECT_THAT(test::ends(test::pathsOfInstances(test::get(association("B", "a")))),
                ElementsAre("Antecedent=B -> Dependent=a"));
    EXPECT_THAT(test::get(association("B", "b")).results, IsEmpty());
    EXPECT_THAT(test::get(association("C", "a")).results, IsEmpty());
}

TEST(CMPIComputerSystemPackage, IsGivenOnceWhereTwoChassisShareTheirSerialNumber) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::chassis(0, 1, "A")});
    EXPECT_THAT(test::ends(test::pathsOfInstances(test::get(association("A", "a")))),
                ElementsAre("Antecedent=A -> Dependent=a"));
}

TEST(CMPIComputerSystemPackage, EndsWithATextWhereALaterKeyOfItsSourceIsNotTold) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")});
    om::Request request = test::asking(
        om::Operation::AssociatorNames,
        test::path("VESKA_ComputerSystem", {{"Name", "a"}, {"CreationClassName", "VESKA_ComputerSystem"}}), className);
    request.fault = om::Fault{*om::faultKind("getKeyAt"), 2, false, false};
    test::takeLog();
    const om::Answer answer = test::provider().run(request);
    EXPECT_TRUE(answer.faulted);
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_THAT(test::takeLog(), Contains(HasSubstr("]: Could not make the path of the other end")));
}

TEST(CMPIComputerSystemPackage, LeadsFromAComputerToAllItsChassisAndBack) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::chassis(0, 1, "B"), test::computer(1, "b"),
                    test::chassis(1, 0, "C")});
    std::vector<std::string> tags;
    for (const om::ObjectPath& path : test::paths(test::associatorNames(computerPath("a"), className))) {
        tags.push_back(test::text(path.keys.back().second));
        const std::vector<om::ObjectPath> back = test::paths(test::associatorNames(path, className));
        ASSERT_EQ(back.size(), 1U);
        EXPECT_EQ(test::text(*test::find(back[0].keys, "Name")), "a");
    }
    EXPECT_THAT(tags, ElementsAre("A", "B"));
}

TEST(CMPIComputerSystemPackage, LeadsToAChassisWithAnEmptySerialNumber) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "")});
    const std::vector<om::ObjectPath> there = test::paths(test::associatorNames(computerPath("a"), className));
    ASSERT_EQ(there.size(), 1U);
    EXPECT_EQ(test::text(*test::find(there[0].keys, "Tag")), "");
}

TEST(CMPIComputerSystemPackage, LeadsFromAChassisNowhereOnAHostWithoutComputer) {
    test::simulate({test::chassis(0, 0, "A")});
    const om::Answer answer = test::associatorNames(test::path("VESKA_PhysicalPackage"), className);
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

// On purpose, bases further up are not reached, nor is the class at this end.
TEST(CMPIComputerSystemPackage, ReachesOnlyTheClassAtTheOtherEndAndItsBase) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")});
    for (const auto& [source, resultClass] :
         {std::pair(computerPath("a"), "CIM_PhysicalElement"), std::pair(computerPath("a"), "CIM_ComputerSystem"),
          std::pair(chassisPath("A"), "CIM_PhysicalPackage")})
        EXPECT_THAT(test::associatorNames(source, className, resultClass).results, IsEmpty()) << resultClass;
}

TEST(CMPIComputerSystemPackage, FailsOnAChassisWithoutSerialNumberBeforeTheOneAskedFor) {
    test::simulate({test::computer(0, "a"), test::without(test::chassis(0, 0, ""), 50), test::chassis(0, 1, "B")});
    test::takeLog();
    const om::Answer answer = test::associatorNames(chassisPath("B"), className);
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done);
    EXPECT_THAT(test::takeLog(), Contains(HasSubstr("]: Serial Property on Chassis not available.")));
}

TEST(CMPIComputerSystemPackage, IsNotGivenByAChassisThatSaysAnotherComputersNode) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")});
    const om::ObjectPath elsewhere = test::path("VESKA_PhysicalPackage", {{"Tag", "A"}, {"SystemName", "/computer/1"}});
    const om::Answer answer =
        test::get(test::associationPath(className, {{"Antecedent", elsewhere}, {"Dependent", computerPath("a")}}));
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_EQ(answer.code, CMPI_RC_OK);
}

// The adapter itself, asked for what the provider does not ask it for.

class CMPIComputerSystemPackageAdapter : public testing::Test {
protected:
    CMPIComputerSystemPackageAdapter() { test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")}); }

    CMPIObjectPath* requestPath(const char* name, const char* key = nullptr, const char* value = nullptr) const {
        CMPIObjectPath* const path = CMNewObjectPath(broker, "root/cimv2", name, nullptr);
        if (key != nullptr) CMAddKey(path, key, reinterpret_cast<const CMPIValue*>(value), CMPI_chars);
        return path;
    }

    const CMPIBroker* const broker = test::provider().broker();
};

using VK::BaseServerProvider::CMPIComputerSystemPackage;

TEST_F(CMPIComputerSystemPackageAdapter, NamesNothingBehindItsLastElement) {
    for (CMPIObjectPath* const source : {requestPath("VESKA_ComputerSystem", "Name", "a"),
                                         requestPath("VESKA_PhysicalPackage", "Tag", "A"), requestPath(className)}) {
        CMPIComputerSystemPackage adapter(broker, nullptr, source);
        ASSERT_TRUE(adapter);
        EXPECT_NE(adapter.getObjectPath(), nullptr);
        for (int step = 0; step < 3; ++step) {
            ++adapter;
            EXPECT_FALSE(adapter) << step;
            EXPECT_EQ(adapter.getObjectPath(), nullptr);
            EXPECT_EQ(adapter.getCMPIInstance(nullptr), nullptr);
        }
    }
}

TEST_F(CMPIComputerSystemPackageAdapter, ReachesNoClassFromASourceThatIsNoEnd) {
    const CMPIComputerSystemPackage adapter(broker, nullptr, requestPath("VESKA_TimeService"));
    for (const char* resultClass : {"VESKA_PhysicalPackage", "CIM_PhysicalPackage", "VESKA_ComputerSystem",
                                    "CIM_ComputerSystem", "VESKA_TimeService"})
        EXPECT_TRUE(adapter.isNotTargetClass(resultClass)) << resultClass;
}

TEST_F(CMPIComputerSystemPackageAdapter, StandsOnNothingWhereTheBrokerMakesNoPath) {
    CMPIBrokerEncFT table = *broker->eft;
    table.newObjectPath = [](const CMPIBroker*, const char*, const char*, CMPIStatus*) -> CMPIObjectPath* {
        return nullptr;
    };
    CMPIBroker spoiled = *broker;
    spoiled.eft = &table;
    for (CMPIObjectPath* const source : {requestPath("VESKA_ComputerSystem"), requestPath("VESKA_PhysicalPackage")})
        EXPECT_FALSE(CMPIComputerSystemPackage(&spoiled, nullptr, source));
}

TEST_F(CMPIComputerSystemPackageAdapter, LeavesOutReferencesThatTheBrokerDoesNotTell) {
    static CMPIObjectPathFT forgetful;
    forgetful = *requestPath(className)->ft;
    forgetful.getKey = [](const CMPIObjectPath*, const char*, CMPIStatus*) { return CMPIData{0, CMPI_nullValue, {}}; };
    forgetful.getKeyAt = nullptr;
    CMPIBrokerEncFT table = *broker->eft;
    table.newInstance = [](const CMPIBroker* theBroker, const CMPIObjectPath* path, CMPIStatus* status) {
        CMPIInstance* const instance = test::provider().broker()->eft->newInstance(theBroker, path, status);
        const_cast<CMPIObjectPath*>(path)->ft = &forgetful;
        return instance;
    };
    CMPIBroker spoiled = *broker;
    spoiled.eft = &table;
    CMPIInstance* const whole = CMPIComputerSystemPackage(broker, nullptr, requestPath(className)).getCMPIInstance({});
    EXPECT_EQ(CMGetPropertyCount(whole, nullptr), 3U);
    CMPIInstance* const part = CMPIComputerSystemPackage(&spoiled, nullptr, requestPath(className)).getCMPIInstance({});
    ASSERT_NE(part, nullptr);
    EXPECT_EQ(CMGetPropertyCount(part, nullptr), 1U) << "the platform's GUID alone";
}

} // namespace
