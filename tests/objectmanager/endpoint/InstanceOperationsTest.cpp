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

std::string list(const std::vector<std::string>& names) {
    std::string values;
    for (const std::string& name : names) values += text(name);
    return parameter("PropertyList", "<VALUE.ARRAY>" + values + "</VALUE.ARRAY>");
}

class InstanceOperations : public testing::Test {
protected:
    InstanceOperations() { simulateNode7(); }
};

TEST_F(InstanceOperations, AnInstanceComesWithItsTypes) {
    const Reply reply = ask("GetInstance", parameter("InstanceName", computerName()));
    ASSERT_EQ(reply.code, 0) << reply.description;
    const pugi::xml_node instance = reply.returned().child("INSTANCE");
    EXPECT_STREQ(instance.attribute("CLASSNAME").value(), "VESKA_ComputerSystem");
    EXPECT_EQ(propertyText(instance, "Name"), "node7");
    EXPECT_STREQ(instance.find_child_by_attribute("NAME", "HealthState").attribute("TYPE").value(), "uint16");
    EXPECT_STREQ(instance.find_child_by_attribute("NAME", "OperationalStatus").name(), "PROPERTY.ARRAY");
}

TEST_F(InstanceOperations, AnInstanceThatTheProviderDoesNotReturnIsNotFound) {
    const std::string unknown = instanceName("VESKA_ComputerSystem", key("CreationClassName", "VESKA_ComputerSystem") +
                                                                         key("Name", "elsewhere"));
    EXPECT_EQ(ask("GetInstance", parameter("InstanceName", unknown)).code, 6);
}

TEST_F(InstanceOperations, APathIsCheckedBeforeTheProviderIsAsked) {
    const auto get = [](const std::string& name) { return ask("GetInstance", parameter("InstanceName", name)).code; };
    const std::string whole = key("CreationClassName", "VESKA_ComputerSystem") + key("Name", "node7");
    EXPECT_EQ(get(instanceName("No_Such", "")), 5);
    EXPECT_EQ(get(instanceName("CIM_ComputerSystem", whole)), 6); // the path has to name the creation class
    EXPECT_EQ(get(instanceName("VESKA_ComputerSystem", "")), 4);
    EXPECT_EQ(get(instanceName("VESKA_ComputerSystem", key("Name", "node7"))), 4);
    EXPECT_EQ(get(instanceName("VESKA_ComputerSystem", whole + key("Nmae", "node7"))), 4);
    EXPECT_EQ(get(instanceName("VESKA_ComputerSystem", whole + key("NAME", "node7"))), 4);
    EXPECT_EQ(get(instanceName("veska_COMPUTERsystem", whole)), 0);
}

TEST_F(InstanceOperations, APathWithoutAKeyNamesAnElementThatHasNone) {
    test::simulate({test::computer(0, "node7"), test::without(test::chassis(0, 0, "CZ1"), 50)});
    const std::string untagged =
        instanceName("VESKA_PhysicalPackage", key("CreationClassName", "VESKA_PhysicalPackage"));
    EXPECT_EQ(ask("GetInstance", parameter("InstanceName", untagged)).code, 0);
    simulateNode7();
    EXPECT_EQ(ask("GetInstance", parameter("InstanceName", untagged)).code, 4);
}

TEST_F(InstanceOperations, APropertyListIsAppliedWhateverTheProviderReturns) {
    const auto get = [](const std::string& more) {
        return propertyNames(
            ask("GetInstance", parameter("InstanceName", computerName()) + more).returned().child("INSTANCE"));
    };
    EXPECT_THAT(get(list({"name", "NAME", "NoSuchProperty"})), ElementsAre("Name"));
    EXPECT_THAT(get(list({})), IsEmpty());
    EXPECT_THAT(get("<IPARAMVALUE NAME=\"PropertyList\"/>"), SizeIs(testing::Gt(5U)));
}

TEST_F(InstanceOperations, LocalOnlyHidesNothing) {
    const Reply reply =
        ask("GetInstance", parameter("InstanceName", timeServiceName()) + parameter("LocalOnly", text("TRUE")));
    EXPECT_THAT(propertyNames(reply.returned().child("INSTANCE")), Contains("SystemName"));
}

TEST_F(InstanceOperations, SaysWhereAPropertyWasDeclaredFirst) {
    const auto origin = [](const std::string& more) {
        const Reply reply = ask("GetInstance", parameter("InstanceName", computerName()) + more);
        const pugi::xml_node instance = reply.returned().child("INSTANCE");
        return std::string(instance.find_child_by_attribute("NAME", "Name").attribute("CLASSORIGIN").value()) + "," +
               instance.find_child_by_attribute("NAME", "UUID").attribute("CLASSORIGIN").value();
    };
    EXPECT_EQ(origin(parameter("IncludeClassOrigin", text("true"))), "CIM_ManagedSystemElement,VESKA_ComputerSystem");
    EXPECT_EQ(origin(""), ",");
}

TEST_F(InstanceOperations, ASuperclassIsEnumeratedThroughItsSubclasses) {
    const Reply reply = ask("EnumerateInstanceNames", parameter("ClassName", className("cim_managedSYSTEMelement")));
    EXPECT_THAT(attributes(reply.results(), "CLASSNAME"),
                UnorderedElementsAre("VESKA_ComputerSystem", "VESKA_PhysicalPackage", "VESKA_TimeService"));
    EXPECT_THAT(ask("EnumerateInstanceNames", parameter("ClassName", className("CIM_Dependency"))).results(),
                SizeIs(1));
}

TEST_F(InstanceOperations, AClassWithoutInstancesHasNone) {
    test::simulate({test::computer(0, "node7")});
    const Reply reply = ask("EnumerateInstances", parameter("ClassName", className("VESKA_PhysicalPackage")));
    EXPECT_EQ(reply.code, 0);
    EXPECT_THAT(reply.results(), IsEmpty());
    EXPECT_TRUE(reply.returned());
    EXPECT_EQ(ask("EnumerateInstances", parameter("ClassName", className("No_Such"))).code, 5);
}

TEST_F(InstanceOperations, WithoutDeepInheritanceSubclassesPropertiesAreLeftOut) {
    const auto names = [](const std::string& more) {
        const Reply reply = ask("EnumerateInstances", parameter("ClassName", className("CIM_ComputerSystem")) + more);
        const pugi::xml_node named = reply.returned().child("VALUE.NAMEDINSTANCE");
        EXPECT_STREQ(named.child("INSTANCENAME").attribute("CLASSNAME").value(), "VESKA_ComputerSystem");
        return propertyNames(named.child("INSTANCE"));
    };
    EXPECT_THAT(names(""), Contains("UUID"));
    EXPECT_THAT(names(parameter("DeepInheritance", text("FALSE"))), Not(Contains("UUID")));
    EXPECT_THAT(names(parameter("DeepInheritance", text("FALSE"))), Contains("Name"));
}

TEST_F(InstanceOperations, APropertyCanBeGotAlone) {
    const auto get = [](const char* name) {
        return ask("GetProperty", parameter("InstanceName", computerName()) + parameter("PropertyName", text(name)));
    };
    EXPECT_STREQ(get("name").returned().child("VALUE").text().get(), "node7");
    EXPECT_TRUE(get("OperationalStatus").returned().child("VALUE.ARRAY"));
    EXPECT_EQ(get("Caption").code, 0); // declared, without a value
    EXPECT_FALSE(get("Caption").returned());
    EXPECT_EQ(get("NoSuchProperty").code, 12);
}

std::string modification(const std::string& name, const std::string& properties,
                         const std::string& ofClass = "VESKA_TimeService") {
    return parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + name + "<INSTANCE CLASSNAME=\"" + ofClass + "\">" +
                                             properties + "</INSTANCE></VALUE.NAMEDINSTANCE>");
}

std::string property(const std::string& name, const std::string& type, const std::string& value) {
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\" CLASSORIGIN=\"X\" PROPAGATED=\"true\">" +
           text(value) + "</PROPERTY>";
}

TEST_F(InstanceOperations, AModificationReachesTheHost) {
    const std::string name = timeServiceName();
    const auto dst = [](const char* value) { return property("AutomaticDSTAdjustment", "boolean", value); };
    EXPECT_EQ(ask("ModifyInstance", modification(name, dst("TRUE"))).code, 0);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 1);
    // A whole instance echoed, of which the list names nothing, changes nothing.
    EXPECT_EQ(ask("ModifyInstance", modification(name, dst("FALSE")) + list({})).code, 0);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 1);
    EXPECT_EQ(ask("ModifyInstance", modification(name, dst("false")) + list({"automaticdstadjustment"})).code, 0);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 0);
}

TEST_F(InstanceOperations, APropertyCanBeSetAlone) {
    const auto set = [](const char* property, const std::string& value) {
        return ask("SetProperty",
                   parameter("InstanceName", timeServiceName()) + parameter("PropertyName", text(property)) + value)
            .code;
    };
    EXPECT_EQ(set("AutomaticDSTAdjustment", parameter("NewValue", text("TRUE"))), 0);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 1);
    EXPECT_EQ(set("AutomaticDSTAdjustment", parameter("NewValue", text("1"))), 13);
    EXPECT_EQ(set("NoSuchProperty", parameter("NewValue", text("1"))), 12);
}

TEST_F(InstanceOperations, AModificationIsCheckedFirst) {
    const auto modify = [](const std::string& parameters) { return ask("ModifyInstance", parameters).code; };
    const std::string name = timeServiceName();
    EXPECT_EQ(modify(modification(name, property("NoSuch", "string", "x"))), 12);
    EXPECT_EQ(modify(modification(name, property("AutomaticDSTAdjustment", "string", "true"))), 13);
    EXPECT_EQ(modify(modification(name, property("AutomaticDSTAdjustment", "boolean", "1"))), 13);
    EXPECT_EQ(modify(modification(name, "", "VESKA_ComputerSystem")), 4);
    EXPECT_EQ(modify(modification(instanceName("VESKA_TimeService", key("Name", "x")), "")), 4);
    EXPECT_EQ(modify(modification(instanceName("No_Such", ""), "", "No_Such")), 5);
    EXPECT_EQ(modify(modification(name, "") + list({"NoSuch"})), 12);
    EXPECT_EQ(modify(parameter("ModifiedInstance", text("x"))), 4);
    EXPECT_EQ(modify(""), 4);
}

TEST_F(InstanceOperations, WhatTheProviderDoesNotOfferIsNotSupported) {
    EXPECT_EQ(ask("DeleteInstance", parameter("InstanceName", computerName())).code, 7);
    EXPECT_EQ(ask("ModifyInstance", modification(computerName(), "", "VESKA_ComputerSystem")).code, 7);
    const std::string made =
        "<INSTANCE CLASSNAME=\"VESKA_ComputerSystem\">" + property("Name", "string", "x") + "</INSTANCE>";
    EXPECT_EQ(ask("CreateInstance", parameter("NewInstance", made)).code, 7);
    EXPECT_EQ(ask("CreateInstance", parameter("NewInstance", "<INSTANCE CLASSNAME=\"No_Such\"/>")).code, 5);
}

} // namespace
} // namespace endpoint
