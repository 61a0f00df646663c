#include "objectmanager/cimxml/Request.h"

#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Errors.h"
#include "objectmanager/model/Names.h"

#include <algorithm>

namespace cimxml {
namespace {

using namespace std::string_view_literals;

/// Versions are taken by their first number.
void checkVersion(const std::string& version, char major, const char* cimError) {
    if (version.size() < 3 || version[0] != major || version[1] != '.') {
        throw Refusal(501, cimError, "version " + version);
    }
}

/// A message says what it is, and every text is read as UTF-8.
void checkDeclaration(const pugi::xml_document& document) {
    const pugi::xml_node first = document.first_child();
    if (first.type() != pugi::node_declaration) throw notValid("no XML declaration");
    const std::string encoding = first.attribute("encoding").as_string("utf-8");
    if (!om::sameName(encoding, "utf-8")) throw notValid("encoding " + encoding);
}

pugi::xml_node childNamed(const pugi::xml_node& node, std::string_view name) {
    const pugi::xml_node child = onlyChild(node);
    if (child.name() != name) throw notValid(std::string("element ") + child.name() + " in " + node.name());
    return child;
}

ParameterElement readParameter(const pugi::xml_node& node) {
    ParameterElement parameter;
    parameter.name = required(node, "NAME");
    parameter.type = node.attribute("PARAMTYPE").as_string();
    const std::vector<pugi::xml_node> children = childElements(node);
    if (children.empty()) return parameter;
    if (children.size() > 1 || !isValueElement(children.front().name())) {
        throw notValid("parameter " + parameter.name + " holds no value");
    }
    parameter.value = readValue(children.front());
    return parameter;
}

/// The call's children: where it goes, then its parameters.
void readCall(const pugi::xml_node& call, Request& request) {
    checkAttributes(call, {"NAME"});
    request.name = required(call, "NAME");
    const std::vector<pugi::xml_node> children = childElements(call);
    if (children.empty()) throw notValid("a call without a namespace");
    if (request.intrinsic) {
        request.nameSpace = readLocalNameSpace(children.front());
    } else {
        const std::string_view kind = children.front().name();
        if (kind != "LOCALINSTANCEPATH" && kind != "LOCALCLASSPATH") throw notValid("a method of no object");
        request.target = readPath(children.front());
        request.nameSpace = request.target.nameSpace;
    }
    for (std::size_t i = 1; i < children.size(); ++i) {
        const pugi::xml_node& child = children[i];
        if (child.name() != (request.intrinsic ? "IPARAMVALUE"sv : "PARAMVALUE"sv)) {
            throw notValid(std::string("element ") + child.name() + " in " + call.name());
        }
        if (request.intrinsic) {
            checkAttributes(child, {"NAME"});
        } else {
            checkAttributes(child, {"NAME", "PARAMTYPE", "EmbeddedObject", "EMBEDDEDOBJECT"});
        }
        request.parameters.push_back(readParameter(child));
    }
}

} // namespace

Request readRequest(std::string_view body) {
    pugi::xml_document document;
    load(document, body, mostElements);
    checkDeclaration(document);
    const pugi::xml_node cim = document.document_element();
    if (cim.name() != "CIM"sv) throw notValid("the outermost element is not CIM");
    checkAttributes(cim, {"CIMVERSION", "DTDVERSION"});
    checkVersion(required(cim, "CIMVERSION"), '2', "unsupported-cim-version");
    checkVersion(required(cim, "DTDVERSION"), '2', "unsupported-dtd-version");

    const pugi::xml_node message = childNamed(cim, "MESSAGE");
    checkAttributes(message, {"ID", "PROTOCOLVERSION"});
    Request request;
    request.id = required(message, "ID");
    request.protocolVersion = required(message, "PROTOCOLVERSION");
    checkVersion(request.protocolVersion, '1', "unsupported-protocol-version");

    const pugi::xml_node content = onlyChild(message);
    if (content.name() == "MULTIREQ"sv) {
        throw Refusal(501, "multiple-requests-unsupported", "several requests in one message");
    }
    if (content.name() != "SIMPLEREQ"sv) throw notValid("the message holds no request");
    checkAttributes(content, {});
    const std::vector<pugi::xml_node> children = childElements(content);
    const auto isCorrelator = [](const pugi::xml_node& child) { return child.name() == "CORRELATOR"sv; };
    const auto first = std::find_if_not(children.begin(), children.end(), isCorrelator);
    if (children.end() - first != 1) throw notValid("a request of one call");
    const std::string_view call = first->name();
    if (call != "IMETHODCALL" && call != "METHODCALL") throw notValid("the request holds no call");
    request.intrinsic = call == "IMETHODCALL";
    readCall(*first, request);
    return request;
}

} // namespace cimxml
