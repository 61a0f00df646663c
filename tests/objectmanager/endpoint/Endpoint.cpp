#include "tests/objectmanager/endpoint/Endpoint.h"

#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Request.h"
#include "support/HostName.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <algorithm>
#include <sstream>

namespace endpoint {

Operations& operations() {
    static Operations made({{"root/cimv2",
                             {},
                             &om::Schema::builtin(),
                             [](const om::Request& request) { return test::provider().run(request); }}},
                           "host1");
    return made;
}

Caller administrator() {
    return {"root", "", true, true};
}

std::vector<pugi::xml_node> Reply::results() const {
    return {returned().begin(), returned().end()};
}

std::string Reply::out(const std::string& name) const {
    return response.find_child_by_attribute("PARAMVALUE", "NAME", name.c_str()).child("VALUE").text().get();
}

std::string Reply::text() const {
    std::ostringstream stream;
    document.save(stream);
    return stream.str();
}

Reply ask(const std::string& message, const Caller& caller) {
    const Outcome outcome = operations().answer(cimxml::readRequest(message), caller);
    Reply reply;
    cimxml::load(reply.document, outcome.message);
    reply.response = reply.document.document_element().child("MESSAGE").child("SIMPLERSP").first_child();
    const pugi::xml_node error = reply.response.child("ERROR");
    reply.code = error ? error.attribute("CODE").as_int() : 0;
    reply.description = error.attribute("DESCRIPTION").as_string();
    return reply;
}

Reply ask(const std::string& operation, const std::string& parameters) {
    return ask(cimxml::intrinsic(operation, parameters), administrator());
}

Reply invoke(const std::string& target, const std::string& method, const std::string& parameters) {
    const std::string element = target.rfind("<CLASSNAME", 0) == 0 ? "LOCALCLASSPATH" : "LOCALINSTANCEPATH";
    return ask(cimxml::message("<SIMPLEREQ><METHODCALL NAME=\"" + method + "\"><" + element + ">" +
                               cimxml::localNameSpace + target + "</" + element + ">" + parameters +
                               "</METHODCALL></SIMPLEREQ>"),
               administrator());
}

std::vector<std::string> propertyNames(const pugi::xml_node& node) {
    std::vector<std::string> names;
    for (const pugi::xml_node& child : node) {
        if (std::string_view(child.name()).substr(0, 8) == "PROPERTY") names.push_back(child.attribute("NAME").value());
    }
    std::sort(names.begin(), names.end());
    return names;
}

std::string propertyText(const pugi::xml_node& instance, const std::string& name) {
    const pugi::xml_node property =
        instance.find_child([&](const pugi::xml_node& node) { return name == node.attribute("NAME").value(); });
    if (!property) return "missing";
    return property.first_child() ? property.child("VALUE").text().get() : "no value";
}

std::vector<std::string> attributes(const std::vector<pugi::xml_node>& nodes, const char* attribute) {
    std::vector<std::string> found;
    for (const pugi::xml_node& node : nodes) found.push_back(node.attribute(attribute).value());
    return found;
}

void simulateNode7() {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1")});
}

std::string computerName() {
    return cimxml::instanceName("VESKA_ComputerSystem", cimxml::key("CreationClassName", "VESKA_ComputerSystem") +
                                                            cimxml::key("Name", "node7"));
}

std::string chassisName() {
    return cimxml::instanceName("VESKA_PhysicalPackage",
                                cimxml::key("CreationClassName", "VESKA_PhysicalPackage") + cimxml::key("Tag", "CZ1"));
}

std::string timeServiceName() {
    const std::string host = test::hostName();
    return cimxml::instanceName("VESKA_TimeService", cimxml::key("SystemCreationClassName", "VESKA_ComputerSystem") +
                                                         cimxml::key("SystemName", host) +
                                                         cimxml::key("CreationClassName", "VESKA_TimeService") +
                                                         cimxml::key("Name", "TimeService@" + host));
}

} // namespace endpoint
