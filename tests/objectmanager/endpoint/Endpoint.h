#pragma once

#include "objectmanager/endpoint/Operations.h"
#include "tests/objectmanager/cimxml/Messages.h"

#include <pugixml.hpp>

#include <string>
#include <vector>

/// The operations over the provider's real library and a simulated host, asked in CIM-XML.
namespace endpoint {

/// The provider in root/cimv2.
Operations& operations();
/// An administrator.
Caller administrator();

/// What came back: the element within IMETHODRESPONSE or METHODRESPONSE, and the status in it.
struct Reply {
    pugi::xml_document document;
    pugi::xml_node response;
    int code = 0;
    std::string description;

    pugi::xml_node returned() const { return response.child("IRETURNVALUE"); }
    /// The children of IRETURNVALUE.
    std::vector<pugi::xml_node> results() const;
    /// An output parameter's text.
    std::string out(const std::string& name) const;
    /// Everything, for messages.
    std::string text() const;
};

Reply ask(const std::string& message, const Caller& caller = administrator());
/// An intrinsic operation in root/cimv2.
Reply ask(const std::string& operation, const std::string& parameters);
/// A method of an instance, or of a class where `target` is CLASSNAME.
Reply invoke(const std::string& target, const std::string& method, const std::string& parameters);

/// The names of properties in an INSTANCE or CLASS, sorted.
std::vector<std::string> propertyNames(const pugi::xml_node& node);
/// The value of one, or "no value" or "missing".
std::string propertyText(const pugi::xml_node& instance, const std::string& name);
/// An attribute of each node.
std::vector<std::string> attributes(const std::vector<pugi::xml_node>& nodes, const char* attribute);

/// node7 with a chassis; INSTANCENAME of what is on it.
void simulateNode7();
std::string computerName();
std::string chassisName();
std::string timeServiceName();

} // namespace endpoint
