#include "objectmanager/endpoint/Interop.h"

#include "objectmanager/cimxml/Document.h"
#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::parameter;

/// An intrinsic operation in the interop namespace, under one of its names.
std::string asked(const std::string& operation, const std::string& parameters, const std::string& space = "interop") {
    static Operations made({interopNameSpace({"root/cimv2"}, "host1")}, "host1");
    std::string path;
    for (std::size_t at = 0; at <= space.size();) {
        const std::size_t end = std::min(space.find('/', at), space.size());
        path += "<NAMESPACE NAME=\"" + space.substr(at, end - at) + "\"/>";
        at = end + 1;
    }
    const std::string message =
        cimxml::intrinsic(operation, parameters, "<LOCALNAMESPACEPATH>" + path + "</LOCALNAMESPACEPATH>");
    return made.answer(cimxml::readRequest(message), administrator()).message;
}

std::vector<std::string> valuesOf(const std::string& message, const std::string& property) {
    pugi::xml_document document;
    cimxml::load(document, message);
    std::vector<std::string> values;
    for (const auto& node : document.select_nodes(("//PROPERTY[@NAME='" + property + "']/VALUE").c_str())) {
        values.emplace_back(node.node().text().get());
    }
    return values;
}

TEST(Interop, ListsEveryNamespaceByItsFullName) {
    for (const char* space : {"interop", "root/interop", "Root/Interop"}) {
        const std::string message =
            asked("EnumerateInstances", parameter("ClassName", className("CIM_Namespace")), space);
        EXPECT_THAT(valuesOf(message, "Name"), testing::ElementsAre("root/cimv2", "interop")) << message;
    }
}

TEST(Interop, HasOneObjectManagerThatSaysItsVersion) {
    const std::string message = asked("EnumerateInstances", parameter("ClassName", className("CIM_ObjectManager")));
    EXPECT_THAT(valuesOf(message, "ElementName"), testing::ElementsAre("vkcimd"));
    EXPECT_THAT(valuesOf(message, "Description"), testing::ElementsAre(testing::HasSubstr("version ")));
}

TEST(Interop, AnInstanceIsFoundByAllOfItsKeys) {
    const auto nameSpace = [](const std::string& which) {
        using cimxml::key;
        return parameter("InstanceName",
                         cimxml::instanceName("VESKA_Namespace",
                                              key("SystemCreationClassName", "CIM_ComputerSystem") +
                                                  key("SystemName", "host1") +
                                                  key("ObjectManagerCreationClassName", "VESKA_ObjectManager") +
                                                  key("ObjectManagerName", "vkcimd") +
                                                  key("CreationClassName", "VESKA_Namespace") + key("Name", which)));
    };
    EXPECT_THAT(valuesOf(asked("GetInstance", nameSpace("interop")), "Name"), testing::ElementsAre("interop"));
    EXPECT_THAT(asked("GetInstance", nameSpace("root/x")), testing::HasSubstr("ERROR CODE=\"6\""));
    EXPECT_THAT(asked("DeleteInstance", nameSpace("interop")), testing::HasSubstr("ERROR CODE=\"7\""));
}

TEST(Interop, NoProfileIsRegisteredAndOtherClassesAreUnknown) {
    EXPECT_THAT(asked("EnumerateInstances", parameter("ClassName", className("CIM_RegisteredProfile"))),
                testing::HasSubstr("<IRETURNVALUE></IRETURNVALUE>"));
    EXPECT_THAT(asked("EnumerateInstances", parameter("ClassName", className("CIM_ComputerSystem"))),
                testing::HasSubstr("ERROR CODE=\"5\""));
    EXPECT_THAT(asked("GetClass", parameter("ClassName", className("CIM_RegisteredProfile"))),
                testing::HasSubstr("DMTF"));
}

} // namespace
} // namespace endpoint
