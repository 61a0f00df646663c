#include "cmpi/CMPIElementCapabilities.h"
#include "support/Associations.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr char className[] = "VESKA_ComputerCapabilities";

om::ObjectPath computerPath(const std::string& name) {
    return test::path("VESKA_ComputerSystem", {{"Name", name}});
}

om::ObjectPath capabilitiesPath(const std::string& id) {
    return test::path("VESKA_EnabledLogicalElementCapabilities", {{"InstanceID", id}});
}

om::ObjectPath association(const std::string& name, const std::string& id) {
    return test::associationPath(className,
                                 {{"ManagedElement", computerPath(name)}, {"Capabilities", capabilitiesPath(id)}});
}

/// What a request answers that finds no instance: nothing, OK, not closed, and the reason in the log.
void expectNotFound(const om::ObjectPath& path, const std::string& reason) {
    test::takeLog();
    const om::Answer answer = test::get(path);
    EXPECT_THAT(answer.results, IsEmpty()) << test::print(path);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done);
    EXPECT_THAT(test::takeLog(), Contains(HasSubstr("]: " + reason)));
}

TEST(CMPIElementCapabilities, EnumerateOneAssociationPerComputerEachWithItsOwnCapabilities) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::computer(1, "b")});
    const om::Answer names = test::names(className);
    EXPECT_THAT(test::ends(test::paths(names)), ElementsAre("ManagedElement=a -> Capabilities=/computer/0",
                                                            "ManagedElement=b -> Capabilities=/computer/1"));
    EXPECT_TRUE(names.done);
    const om::Answer instances = test::instances(className);
    EXPECT_EQ(test::ends(test::pathsOfInstances(instances)), test::ends(test::paths(names)));
    EXPECT_FALSE(instances.done); // on purpose: only the names are closed
}

TEST(CMPIElementCapabilities, HoldTheirReferencesAsProperties) {
    test::simulate({test::computer(0, "node7")});
    const om::Instance instance = test::instancesOf(test::instances(className))[0];
    ASSERT_THAT(test::namesOf(instance.properties), ElementsAre("ManagedElement", "Capabilities"));
    for (const auto& [name, value] : instance.properties) EXPECT_EQ(value.type, CMPI_ref) << name;
    EXPECT_EQ(test::print(*std::get<std::shared_ptr<const om::ObjectPath>>(instance.properties[0].second.data)),
              "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"node7\"");
}

TEST(CMPIElementCapabilities, GiveExactlyTheInstanceThatIsNamed) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    const om::Answer answer = test::get(association("b", "/computer/1"));
    EXPECT_THAT(test::ends(test::pathsOfInstances(answer)),
                ElementsAre("ManagedElement=b -> Capabilities=/computer/1"));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
}

TEST(CMPIElementCapabilities, AreNotFoundWhereTheEndsDoNotBelongTogether) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    expectNotFound(association("a", "/computer/1"), "Could not find instance");
    expectNotFound(association("A", "/computer/0"), "Could not find instance");
}

TEST(CMPIElementCapabilities, AreNotFoundWithoutOneOfTheirKeys) {
    test::simulate({test::computer(0, "a")});
    expectNotFound(test::associationPath(className, {{"ManagedElement", computerPath("a")}}),
                   "Could not find instance");
    expectNotFound(test::associationPath(className, {{"Capabilities", capabilitiesPath("/computer/0")}}),
                   "Could not find instance");
    expectNotFound(test::associationPath(className, {{"ManagedElement", test::path("VESKA_ComputerSystem")},
                                                     {"Capabilities", capabilitiesPath("/computer/0")}}),
                   "Could not find instance");
    expectNotFound(association("a", "/computer/9"), "Concerned Computer Could Not Be Found.");
}

TEST(CMPIElementCapabilities, AreNotFoundOnAHostWithoutComputer) {
    test::simulate({});
    expectNotFound(test::path(className), "Could not find instance");
}

TEST(CMPIElementCapabilities, LeadFromEitherEndToTheOtherAndBack) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    const std::vector<om::ObjectPath> there = test::paths(test::associatorNames(computerPath("b"), className));
    ASSERT_EQ(there.size(), 1U);
    EXPECT_EQ(test::print(there[0]), "VESKA_EnabledLogicalElementCapabilities.InstanceID=\"/computer/1\"");
    const std::vector<om::ObjectPath> back = test::paths(test::associatorNames(there[0], className));
    ASSERT_EQ(back.size(), 1U);
    EXPECT_EQ(test::print(back[0]), "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"b\"");
}

TEST(CMPIElementCapabilities, LeadToAComputerWhoseNameIsEmpty) {
    test::simulate({test::computer(0, "a"), test::computer(1, "")});
    const std::vector<om::ObjectPath> found =
        test::paths(test::associatorNames(capabilitiesPath("/computer/1"), className));
    ASSERT_EQ(found.size(), 1U);
    EXPECT_EQ(test::print(found[0]), "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"\"");
}

TEST(CMPIElementCapabilities, GiveTheWholeInstanceAtTheOtherEnd) {
    test::simulate({test::computer(0, "node7")});
    const om::Answer answer = test::associators(computerPath("node7"), className);
    EXPECT_THAT(test::namesOf(test::instancesOf(answer)[0].properties),
                ElementsAre("InstanceID", "ElementName", "ElementNameEditSupported"));
}

TEST(CMPIElementCapabilities, ReturnNothingWhenAskedFromTheAssociationItself) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    for (const om::ObjectPath& source : {test::path(className), association("a", "/computer/0")}) {
        const om::Answer answer = test::associators(source, className);
        EXPECT_THAT(answer.results, IsEmpty());
        EXPECT_TRUE(answer.done);
    }
}

TEST(CMPIElementCapabilities, FailWhereAComputerHasNoName) {
    test::Node nameless = test::computer(1, "");
    nameless.properties.erase(108);
    test::simulate({test::computer(0, "a"), nameless});
    const om::Answer answer = test::names(className);
    // The first pair stays returned; the second computer's path cannot be followed.
    EXPECT_THAT(test::ends(test::paths(answer)), ElementsAre("ManagedElement=a -> Capabilities=/computer/0"));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done);
}

/// A broker that takes a key of an empty text, and has no such key then.
class BrokerWithoutEmptyKeys {
public:
    BrokerWithoutEmptyKeys() {
        table.newObjectPath = [](const CMPIBroker*, const char* nameSpace, const char* name, CMPIStatus* status) {
            CMPIObjectPath* const made = CMNewObjectPath(usual(), nameSpace, name, status);
            usualPaths = made->ft;
            made->ft = &paths;
            return made;
        };
        paths.addKey = [](CMPIObjectPath* path, const char* name, const CMPIValue* value, CMPIType type) {
            const bool empty = type == CMPI_chars && *reinterpret_cast<const char*>(value) == '\0';
            return empty ? CMPIStatus{CMPI_RC_OK, nullptr} : usualPaths->addKey(Usual(path).path, name, value, type);
        };
        paths.getKey = [](const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
            ++keysAsked;
            return usualPaths->getKey(Usual(path).path, name, status);
        };
        paths.getKeyCount = [](const CMPIObjectPath* path, CMPIStatus* status) {
            return usualPaths->getKeyCount(Usual(path).path, status);
        };
        broker.eft = &table;
    }

    CMPIBroker broker = *usual();
    static inline int keysAsked = 0;

private:
    /// The usual broker knows its paths by their table.
    struct Usual {
        explicit Usual(const CMPIObjectPath* ours) : path(const_cast<CMPIObjectPath*>(ours)) { path->ft = usualPaths; }
        ~Usual() { path->ft = &paths; }
        CMPIObjectPath* const path;
    };

    static const CMPIBroker* usual() { return test::provider().broker(); }

    static inline CMPIObjectPathFT* usualPaths = nullptr;
    static inline CMPIObjectPathFT paths{};
    CMPIBrokerEncFT table = *usual()->eft;
};

TEST(CMPIElementCapabilities, AreNoneForAnUnknownComputerAlsoWhereTheBrokerHasNoEmptyKeys) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    const BrokerWithoutEmptyKeys without;
    for (const auto& [name, found] : {std::pair("a", true), std::pair("unknown", false)}) {
        CMPIObjectPath* const source =
            CMNewObjectPath(test::provider().broker(), "root/cimv2", "VESKA_ComputerSystem", nullptr);
        CMAddKey(source, "Name", reinterpret_cast<const CMPIValue*>(name), CMPI_chars);
        BrokerWithoutEmptyKeys::keysAsked = 0;
        const VK::BaseServerProvider::CMPIElementCapabilities adapter(&without.broker, nullptr, source);
        EXPECT_EQ(static_cast<bool>(adapter), found) << name;
        EXPECT_EQ(BrokerWithoutEmptyKeys::keysAsked, 1) << "by the walk, or to see whether it has an empty one";
    }
}

} // namespace
