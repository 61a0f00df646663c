#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::parameter;
using cimxml::text;
using testing::Contains;
using testing::ElementsAre;
using testing::Not;
using testing::SizeIs;

Reply getClass(const std::string& name, const std::string& more = "") {
    return ask("GetClass", parameter("ClassName", className(name)) + more);
}

pugi::xml_node member(const pugi::xml_node& node, const char* name) {
    return node.find_child_by_attribute("NAME", name);
}

std::string qualifier(const pugi::xml_node& node, const char* name) {
    const pugi::xml_node found = node.find_child_by_attribute("QUALIFIER", "NAME", name);
    if (!found) return "missing";
    return std::string(found.child("VALUE").text().get()) +
           (found.attribute("PROPAGATED").as_bool() ? " (inherited)" : "");
}

TEST(ClassOperations, AClassComesWithItsOwnMembersFirst) {
    const Reply reply = getClass("veska_timeSERVICE");
    const pugi::xml_node found = reply.returned().child("CLASS");
    EXPECT_STREQ(found.attribute("NAME").value(), "VESKA_TimeService");
    EXPECT_STREQ(found.attribute("SUPERCLASS").value(), "CIM_TimeService");
    EXPECT_THAT(propertyNames(found), ElementsAre("AutomaticDSTAdjustment", "CreationClassName", "Name", "Region",
                                                  "SystemCreationClassName", "SystemName"));
    const pugi::xml_node method = member(found, "ManageTime");
    EXPECT_STREQ(method.name(), "METHOD");
    EXPECT_STREQ(method.attribute("TYPE").value(), "uint32");
    EXPECT_STREQ(member(method, "TimeData").attribute("TYPE").value(), "datetime");
    EXPECT_STREQ(member(method, "ManagedElement").attribute("REFERENCECLASS").value(), "CIM_ManagedElement");
}

TEST(ClassOperations, InheritedMembersAreShownWhereTheyAreAskedFor) {
    const Reply reply = getClass("VESKA_TimeService",
                                 parameter("LocalOnly", text("FALSE")) + parameter("IncludeClassOrigin", text("TRUE")));
    const pugi::xml_node found = reply.returned().child("CLASS");
    EXPECT_THAT(propertyNames(found), Contains("Started"));
    EXPECT_TRUE(member(found, "Started").attribute("PROPAGATED").as_bool());
    EXPECT_STREQ(member(found, "Started").attribute("CLASSORIGIN").value(), "CIM_Service");
    EXPECT_FALSE(member(found, "Name").attribute("PROPAGATED"));
    EXPECT_STREQ(member(found, "Name").attribute("CLASSORIGIN").value(), "CIM_ManagedSystemElement");
    EXPECT_TRUE(member(found, "StartService").attribute("PROPAGATED").as_bool());
}

TEST(ClassOperations, QualifiersAreInheritedAsTheirKindSays) {
    const pugi::xml_document document;
    const Reply reply = getClass("VESKA_ComputerSystem");
    const pugi::xml_node found = reply.returned().child("CLASS");
    EXPECT_EQ(qualifier(found, "Version"), "1.0.0");
    EXPECT_EQ(qualifier(member(found, "Name"), "Key"), "TRUE (inherited)");
    EXPECT_EQ(qualifier(member(found, "Name"), "Override"), "Name");
    const pugi::xml_node values =
        member(found, "HealthState").find_child_by_attribute("QUALIFIER", "NAME", "Values").child("VALUE.ARRAY");
    EXPECT_STREQ(values.first_child().text().get(), "Unknown");
    EXPECT_THAT(getClass("VESKA_ComputerSystem", parameter("IncludeQualifiers", text("FALSE"))).text(),
                Not(testing::HasSubstr("<QUALIFIER")));
}

TEST(ClassOperations, AnAssociationsReferencesSayTheirClass) {
    const Reply reply = getClass("VESKA_ComputerSystemPackage");
    const pugi::xml_node found = reply.returned().child("CLASS");
    EXPECT_EQ(qualifier(found, "Association"), "TRUE");
    EXPECT_STREQ(member(found, "Antecedent").name(), "PROPERTY.REFERENCE");
    EXPECT_STREQ(member(found, "Antecedent").attribute("REFERENCECLASS").value(), "VESKA_PhysicalPackage");
}

TEST(ClassOperations, AListSelectsProperties) {
    const Reply reply =
        getClass("VESKA_ComputerSystem", parameter("PropertyList", "<VALUE.ARRAY><VALUE>uuid</VALUE></VALUE.ARRAY>"));
    EXPECT_THAT(propertyNames(reply.returned().child("CLASS")), ElementsAre("UUID"));
}

TEST(ClassOperations, AnUnknownClassIsNotFound) {
    EXPECT_EQ(getClass("No_Such").code, 6);
    EXPECT_EQ(ask("EnumerateClassNames", parameter("ClassName", className("No_Such"))).code, 5);
    EXPECT_EQ(ask("GetClass", "").code, 4);
}

TEST(ClassOperations, ClassesAreListedFromTheTopOrFromAClass) {
    const auto names = [](const std::string& parameters) {
        return attributes(ask("EnumerateClassNames", parameters).results(), "NAME");
    };
    const std::string deep = parameter("DeepInheritance", text("TRUE"));
    EXPECT_THAT(names(""), Contains("CIM_ManagedElement"));
    EXPECT_THAT(names(""), Not(Contains("CIM_System")));
    EXPECT_THAT(names(deep), SizeIs(om::Schema::builtin().classes().size()));
    EXPECT_THAT(names(parameter("ClassName", className("CIM_System"))), ElementsAre("CIM_ComputerSystem"));
    EXPECT_THAT(names(parameter("ClassName", className("CIM_System")) + deep),
                ElementsAre("CIM_ComputerSystem", "VESKA_ComputerSystem"));
    EXPECT_THAT(names(parameter("ClassName", className("VESKA_ComputerSystem")) + deep), testing::IsEmpty());
    EXPECT_THAT(ask("EnumerateClasses", parameter("ClassName", className("CIM_System"))).results(), SizeIs(1));
}

TEST(ClassOperations, QualifiersAreDeclared) {
    const Reply reply = ask("GetQualifier", parameter("QualifierName", text("association")));
    const pugi::xml_node found = reply.returned().child("QUALIFIER.DECLARATION");
    EXPECT_STREQ(found.attribute("NAME").value(), "Association");
    EXPECT_STREQ(found.attribute("OVERRIDABLE").value(), "false");
    EXPECT_STREQ(found.child("SCOPE").attribute("ASSOCIATION").value(), "true");
    EXPECT_STREQ(found.child("VALUE").text().get(), "FALSE");
    EXPECT_EQ(ask("GetQualifier", parameter("QualifierName", text("NoSuch"))).code, 6);
}

TEST(ClassOperations, EveryQualifierOfTheSchemaIsDeclared) {
    const std::vector<std::string> declared = attributes(ask("EnumerateQualifiers", "").results(), "NAME");
    const auto expectDeclared = [&](const om::Qualifiers& qualifiers) {
        for (const auto& qualifier : qualifiers) EXPECT_THAT(declared, Contains(qualifier.first));
    };
    for (const om::ClassDeclaration& each : om::Schema::builtin().classes()) {
        expectDeclared(each.qualifiers);
        for (const auto& property : each.properties) expectDeclared(property.qualifiers);
        for (const auto& method : each.methods) {
            expectDeclared(method.qualifiers);
            for (const auto& parameter : method.parameters) expectDeclared(parameter.qualifiers);
        }
    }
}

} // namespace
} // namespace endpoint
