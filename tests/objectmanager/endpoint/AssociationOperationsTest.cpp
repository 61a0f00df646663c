#include "support/SimulatedHost.h"
#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::instanceName;
using cimxml::key;
using cimxml::parameter;
using cimxml::text;
using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::UnorderedElementsAre;

class AssociationOperations : public testing::Test {
protected:
    AssociationOperations() { simulateNode7(); }
};

/// The classes of what AssociatorNames returns.
std::vector<std::string> found(const std::string& source, const std::string& more = "") {
    const Reply reply = ask("AssociatorNames", parameter("ObjectName", source) + more);
    EXPECT_EQ(reply.code, 0) << reply.description;
    std::vector<std::string> classes;
    for (const pugi::xml_node& result : reply.results()) {
        const pugi::xml_node path = result.first_child();
        const pugi::xml_node name = path.last_child();
        classes.emplace_back(name.attribute(path.name() == std::string("CLASSPATH") ? "NAME" : "CLASSNAME").value());
    }
    return classes;
}

std::string filter(const std::string& name, const std::string& value) {
    return parameter(name, name.find("Class") != std::string::npos ? className(value) : text(value));
}

TEST_F(AssociationOperations, WithoutFiltersAllAssociationsAreFollowed) {
    EXPECT_THAT(
        found(computerName()),
        UnorderedElementsAre("VESKA_PhysicalPackage", "VESKA_EnabledLogicalElementCapabilities", "VESKA_TimeService"));
    EXPECT_THAT(found(chassisName()), ElementsAre("VESKA_ComputerSystem"));
}

TEST_F(AssociationOperations, EachFilterIsApplied) {
    const std::string computer = computerName();
    EXPECT_THAT(found(computer, filter("AssocClass", "veska_computerSYSTEMpackage")),
                ElementsAre("VESKA_PhysicalPackage"));
    EXPECT_THAT(found(computer, filter("AssocClass", "CIM_Dependency")), ElementsAre("VESKA_PhysicalPackage"));
    EXPECT_THAT(found(computer, filter("ResultClass", "CIM_Capabilities")),
                ElementsAre("VESKA_EnabledLogicalElementCapabilities"));
    EXPECT_THAT(found(computer, filter("ResultClass", "VESKA_ComputerSystem")), IsEmpty());
    EXPECT_THAT(found(computer, filter("Role", "dependent")), ElementsAre("VESKA_PhysicalPackage"));
    EXPECT_THAT(found(computer, filter("Role", "Antecedent")), IsEmpty());
    EXPECT_THAT(found(computer, filter("ResultRole", "Capabilities")),
                ElementsAre("VESKA_EnabledLogicalElementCapabilities"));
    EXPECT_THAT(found(computer, filter("Role", "NoSuchRole")), IsEmpty());
    EXPECT_THAT(found(computer, filter("Role", "Dependent") + filter("ResultRole", "Dependent")), IsEmpty());
    EXPECT_THAT(found(computer, filter("Role", "") + "<IPARAMVALUE NAME=\"ResultClass\"></IPARAMVALUE>"), SizeIs(3));
}

TEST_F(AssociationOperations, ClassesHaveToBeKnown) {
    const auto code = [](const std::string& parameters) { return ask("Associators", parameters).code; };
    EXPECT_EQ(code(parameter("ObjectName", instanceName("No_Such", key("A", "b")))), 4);
    EXPECT_EQ(code(parameter("ObjectName", computerName()) + filter("AssocClass", "No_Such")), 4);
    EXPECT_EQ(code(parameter("ObjectName", computerName()) + filter("ResultClass", "No_Such")), 4);
    EXPECT_EQ(code(parameter("ObjectName", instanceName("VESKA_ComputerSystem", key("Nmae", "x")))), 4);
    EXPECT_EQ(code(""), 4);
}

TEST_F(AssociationOperations, InstancesComeWithWholePathsAndTheSelectedProperties) {
    const Reply reply =
        ask("Associators", parameter("ObjectName", chassisName()) +
                               parameter("PropertyList", "<VALUE.ARRAY><VALUE>HealthState</VALUE></VALUE.ARRAY>"));
    ASSERT_THAT(reply.results(), SizeIs(1)) << reply.text();
    const pugi::xml_node object = reply.results().front();
    EXPECT_STREQ(object.name(), "VALUE.OBJECTWITHPATH");
    const pugi::xml_node path = object.child("INSTANCEPATH");
    EXPECT_STREQ(path.child("NAMESPACEPATH").child("HOST").text().get(), "host1");
    EXPECT_THAT(std::vector<pugi::xml_node>(path.child("INSTANCENAME").begin(), path.child("INSTANCENAME").end()),
                SizeIs(2));
    EXPECT_THAT(propertyNames(object.child("INSTANCE")), ElementsAre("HealthState"));
}

TEST_F(AssociationOperations, ReferencesAreNotSupportedByTheProvider) {
    EXPECT_EQ(ask("References", parameter("ObjectName", computerName())).code, 7);
    EXPECT_EQ(ask("ReferenceNames", parameter("ObjectName", computerName())).code, 7);
}

TEST_F(AssociationOperations, OfAClassTheSchemaIsAsked) {
    EXPECT_THAT(found(className("VESKA_ComputerSystem"), filter("AssocClass", "VESKA_ComputerSystemPackage")),
                ElementsAre("VESKA_PhysicalPackage"));
    // Some clients send the name of an instance without keys.
    EXPECT_THAT(found(instanceName("VESKA_ComputerSystem", ""), filter("AssocClass", "VESKA_ComputerSystemPackage")),
                ElementsAre("VESKA_PhysicalPackage"));
    const Reply reply = ask("References", parameter("ObjectName", className("VESKA_PhysicalPackage")) +
                                              filter("ResultClass", "CIM_SystemPackaging"));
    ASSERT_THAT(reply.results(), SizeIs(3)) << reply.text();
    EXPECT_STREQ(reply.results().back().child("CLASS").attribute("NAME").value(), "VESKA_ComputerSystemPackage");
    EXPECT_TRUE(reply.results().front().child("CLASSPATH"));
    EXPECT_THAT(ask("ReferenceNames", parameter("ObjectName", className("VESKA_PhysicalPackage")) +
                                          filter("ResultClass", "VESKA_ComputerCapabilities"))
                    .results(),
                IsEmpty());
}

} // namespace
} // namespace endpoint
