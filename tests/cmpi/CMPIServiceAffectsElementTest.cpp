#include "support/HostName.h"
#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using test::hostName;
using test::printed;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr char association[] = "VESKA_TimeServiceAffectsElement";

om::ObjectPath computer(const std::string& name) {
    return test::path("VESKA_ComputerSystem", {{"CreationClassName", "VESKA_ComputerSystem"}, {"Name", name}});
}

om::ObjectPath timeService(const std::string& name) {
    return test::path("VESKA_TimeService", {{"Name", "TimeService@" + name},
                                            {"CreationClassName", "VESKA_TimeService"},
                                            {"SystemName", name},
                                            {"SystemCreationClassName", "VESKA_ComputerSystem"}});
}

std::vector<std::string> otherEnds(const om::ObjectPath& source) {
    const om::Answer answer = test::associatorNames(source, association);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
    return printed(answer);
}

std::string pairOf(const std::string& computerName) {
    return std::string(association) + ".AffectedElement=(" + test::print(computer(computerName)) +
           "),AffectingElement=(" + test::print(timeService(hostName())) + ")";
}

TEST(CMPITimeServiceAffectsElement, LeadsFromAnyComputerToTheTimeServiceOfThisHost) {
    for (const std::string& name : {hostName(), std::string("other")}) {
        test::simulate({test::computer(0, name)});
        EXPECT_THAT(otherEnds(computer(name)), ElementsAre(test::print(timeService(hostName()))));
        EXPECT_THAT(otherEnds(computer("a third")), ElementsAre(test::print(timeService(hostName()))));
    }
}

TEST(CMPITimeServiceAffectsElement, LeadsFromTheTimeServiceToTheComputerWithTheHostsName) {
    test::simulate({test::computer(0, "other"), test::computer(1, hostName()), test::computer(2, "third")});
    EXPECT_THAT(otherEnds(timeService(hostName())), ElementsAre(test::print(computer(hostName()))));
    EXPECT_THAT(otherEnds(timeService("other")), ElementsAre(test::print(computer(hostName()))))
        << "the time service's keys do not matter";
}

TEST(CMPITimeServiceAffectsElement, LeadsFromTheTimeServiceNowhereWhenNoComputerHasTheHostsName) {
    test::simulate({test::computer(0, "other")});
    EXPECT_THAT(otherEnds(timeService(hostName())), IsEmpty());
    EXPECT_THAT(otherEnds(timeService("other")), IsEmpty());
}

TEST(CMPITimeServiceAffectsElement, LeadsFromAKeylessTimeServiceToAllComputers) {
    test::simulate({test::computer(0, "one"), test::computer(1, "two")});
    EXPECT_THAT(otherEnds(test::path("VESKA_TimeService")),
                ElementsAre(test::print(computer("one")), test::print(computer("two"))));
}

TEST(CMPITimeServiceAffectsElement, HandsOutTheInstanceAtTheOtherEnd) {
    test::simulate({test::computer(0, hostName())});
    const om::Answer services = test::associators(computer(hostName()), association);
    EXPECT_TRUE(services.done);
    ASSERT_THAT(services.results, SizeIs(1));
    EXPECT_EQ(test::print(test::instancesOf(services)[0].path), test::print(timeService(hostName())));
    EXPECT_NE(test::find(test::instancesOf(services)[0].properties, "AutomaticDSTAdjustment"), nullptr);

    const om::Answer computers = test::associators(timeService(hostName()), association);
    ASSERT_THAT(computers.results, SizeIs(1));
    EXPECT_EQ(test::print(test::instancesOf(computers)[0].path), test::print(computer(hostName())));
    EXPECT_NE(test::find(test::instancesOf(computers)[0].properties, "HealthState"), nullptr);
}

TEST(CMPITimeServiceAffectsElement, LeadsNowhereFromTheConfigurationAndFromItself) {
    test::simulate({test::computer(0, hostName())});
    for (const char* source : {"VESKA_CIMServiceConfig", association})
        EXPECT_THAT(otherEnds(test::path(source)), IsEmpty()) << source;
}

TEST(CMPITimeServiceAffectsElement, AskedByItsOwnClassIsOnePair) {
    test::simulate({test::computer(0, "one")});
    EXPECT_THAT(printed(test::names(association)), ElementsAre(pairOf("one")));
    test::simulate({test::computer(0, "one"), test::computer(1, hostName()), test::computer(2, "three")});
    const om::Answer answer = test::names(association);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done) << "the result is left open, which is meant";
    EXPECT_THAT(printed(answer), ElementsAre(pairOf("one"))) << "both ends move in step, and there is one time service";
}

TEST(CMPITimeServiceAffectsElement, AskedByItsOwnClassIsNoPairWithoutAComputer) {
    test::simulate({});
    EXPECT_EQ(test::names(association).code, CMPI_RC_OK);
    EXPECT_THAT(test::names(association).results, IsEmpty());
    EXPECT_THAT(test::instances(association).results, IsEmpty());
}

TEST(CMPITimeServiceAffectsElement, OfAnotherHostsKeysIsStillThisHostsPair) {
    test::simulate({test::computer(0, "one")});
    for (const om::ObjectPath& asked :
         {test::associationPath(association, {{"AffectedElement", computer("another host")},
                                              {"AffectingElement", timeService("another host")}}),
          test::path(association, {{"Name", "another host"}, {"SystemName", "another host"}})})
        EXPECT_THAT(printed(test::provider().run(test::asking(om::Operation::EnumInstanceNames, asked))),
                    ElementsAre(pairOf("one")));
}

TEST(CMPITimeServiceAffectsElement, CarriesItsReferencesAsProperties) {
    test::simulate({test::computer(0, "one")});
    const om::Answer answer = test::instances(association);
    EXPECT_FALSE(answer.done) << "the result is left open, which is meant";
    ASSERT_THAT(answer.results, SizeIs(1));
    const om::Instance instance = test::instancesOf(answer)[0];
    ASSERT_THAT(test::namesOf(instance.properties), ElementsAre("AffectedElement", "AffectingElement"));
    const std::vector<std::string> ends = {test::print(computer("one")), test::print(timeService(hostName()))};
    for (std::size_t index = 0; index < ends.size(); ++index) {
        const om::Value& value = instance.properties[index].second;
        EXPECT_EQ(value.type, CMPI_ref);
        EXPECT_EQ(test::print(*std::get<std::shared_ptr<const om::ObjectPath>>(value.data)), ends[index]);
    }
}

} // namespace
