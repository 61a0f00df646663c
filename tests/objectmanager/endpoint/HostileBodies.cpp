#include "tests/objectmanager/endpoint/HostileRequests.h"

#include "objectmanager/cimxml/Document.h"

namespace endpoint {
namespace {

using cimxml::cim;
using cimxml::className;
using cimxml::localNameSpace;
using cimxml::message;
using cimxml::parameter;
using cimxml::text;

constexpr const char* notWellFormed = "request-not-well-formed";
constexpr const char* notValid = "request-not-valid";

/// A good request with this in the place of its parameters.
std::string intrinsic(const std::string& parameters, const std::string& nameSpace = localNameSpace) {
    return cimxml::intrinsic("EnumerateClassNames", parameters, nameSpace);
}

/// One that is well-formed where the text is.
HttpRequest withText(const std::string& content) {
    return withBody(intrinsic(parameter("ClassName", text(content))));
}

HttpRequest nested(int depth) {
    return withBody(intrinsic(parameter("ClassName", repeated("<VALUE>", depth) + repeated("</VALUE>", depth))));
}

/// A good document with something before it, behind its declaration.
std::string behindDeclaration(const std::string& markup) {
    const std::string good = goodRequest().body;
    return good.substr(0, good.find("<CIM")) + markup + good.substr(good.find("<CIM"));
}

/// Entities of which each stands for ten of the one before.
std::string entityBomb() {
    std::string type = "<!DOCTYPE CIM [<!ENTITY e0 'aaaaaaaaaa'>";
    for (int i = 1; i < 10; ++i) {
        type += "<!ENTITY e" + std::to_string(i) + " '";
        for (int times = 0; times < 10; ++times) type += "&e" + std::to_string(i - 1) + ';';
        type += "'>";
    }
    return behindDeclaration(type + "]>");
}

std::string versions(const char* cimVersion, const char* dtdVersion, const char* protocolVersion) {
    return std::string("<?xml version='1.0'?><CIM CIMVERSION='") + cimVersion + "' DTDVERSION='" + dtdVersion +
           "'><MESSAGE ID='1' PROTOCOLVERSION='" + protocolVersion +
           "'><SIMPLEREQ><IMETHODCALL NAME='EnumerateClassNames'>" + localNameSpace +
           "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
}

HostileRequests characters() {
    const std::string good = goodRequest().body;
    return {
        {"no body", withBody(""), "400", notWellFormed},
        {"blanks", withBody("   "), "400", notWellFormed},
        {"JSON", withBody("{\"a\": 1}"), "400", notWellFormed},
        {"Latin-1", withText("caf\xE9"), "400", notWellFormed},
        {"a character cut in two", withText("\xC3"), "400", notWellFormed},
        {"a character longer than it has to be", withText("\xC0\x80"), "400", notWellFormed},
        {"half of a pair of UTF-16", withText("\xED\xA0\x80"), "400", notWellFormed},
        {"UTF-16", withBody(std::string("\xFF\xFE<\0C\0I\0M\0/\0>\0", 14)), "400", notWellFormed},
        {"a zero byte", withText(std::string(1, '\0')), "400", notWellFormed},
        {"a zero byte behind the end", withBody(good + std::string(1, '\0')), "400", notWellFormed},
        {"a control character", withText("\x1B[2J"), "400", notWellFormed},
        {"a reference to a control character", withText("&#27;"), "400", notWellFormed},
        {"a reference to a zero byte", withText("&#0;"), "400", notWellFormed},
        {"a reference behind the last character", withText("&#x110000;"), "400", notWellFormed},
        {"a reference to half of a pair", withText("&#xD800;"), "400", notWellFormed},
        {"an unknown entity", withText("&nbsp;"), "400", notWellFormed},
        {"an ampersand", withText("a & b"), "400", notWellFormed},
    };
}

HostileRequests markup() {
    const std::string good = goodRequest().body;
    const std::string many = repeated("<VALUE/>", cimxml::mostElements);
    return {
        {"a third of a body", withBody(good.substr(0, good.size() / 3)), "400", notWellFormed},
        {"a body without its last byte", withBody(good.substr(0, good.size() - 1)), "400", notWellFormed},
        {"a body twice", withBody(good + good), "400", notWellFormed},
        {"a tag that another one closes", withText("<B></C></B>"), "400", notWellFormed},
        {"an attribute without quotes", withBody(behindDeclaration("<A x=1/>")), "400", notWellFormed},
        {"an attribute twice", withBody(intrinsic("<IPARAMVALUE NAME='A' NAME='A'/>")), "400", notWellFormed},
        {"a comment without an end", withBody(behindDeclaration("<!-- ")), "400", notWellFormed},
        {"a section without an end", withText("<![CDATA[ "), "400", notWellFormed},
        {"a document type", withBody(behindDeclaration("<!DOCTYPE CIM>")), "400", notValid},
        {"a document type of its own", withBody(behindDeclaration("<!DOCTYPE html [<!ELEMENT html ANY>]>")), "400",
         notValid},
        {"a document type from a file", withBody(behindDeclaration("<!DOCTYPE CIM SYSTEM 'file:///etc/passwd'>")),
         "400", notValid},
        {"a document type from elsewhere", withBody(behindDeclaration("<!DOCTYPE CIM SYSTEM 'http://node8/cim.dtd'>")),
         "400", notValid},
        {"an entity bomb", withBody(entityBomb()), "400", notValid},
        {"an entity from a file",
         withBody(behindDeclaration("<!DOCTYPE CIM [<!ENTITY e SYSTEM 'file:///etc/shadow'>]>")), "400", notValid},
        {"an entity of parameters", withBody(behindDeclaration("<!DOCTYPE CIM [<!ENTITY % p 'a'> %p;]>")), "400",
         notValid},
        {"elements nested deeply", nested(cimxml::deepestElement), "400", notValid},
        {"elements nested very deeply", nested(50000), "400", notValid},
        {"too many elements", withBody(intrinsic(parameter("ClassName", "<VALUE.ARRAY>" + many + "</VALUE.ARRAY>"))),
         "400", notValid},
    };
}

HostileRequests envelopes() {
    const std::string call = "<IMETHODCALL NAME=\"GetClass\">" + localNameSpace + "</IMETHODCALL>";
    const std::string simple = "<SIMPLEREQ>" + call + "</SIMPLEREQ>";
    const std::string good = goodRequest().body;
    const std::string undeclared = good.substr(good.find("<CIM"));
    return {
        {"no XML declaration", withBody(undeclared), "400", notValid},
        {"another encoding", withBody("<?xml version='1.0' encoding='iso-8859-1'?>" + undeclared), "400", notValid},
        {"another outermost element", withBody("<?xml version='1.0'?><XML/>"), "400", notValid},
        {"CIM without versions", withBody("<?xml version='1.0'?><CIM/>"), "400", notValid},
        {"CIM without a version of the DTD", withBody("<?xml version='1.0'?><CIM CIMVERSION='2.0'/>"), "400", notValid},
        {"another version of CIM", withBody(versions("3.0", "2.0", "1.0")), "501", "unsupported-cim-version"},
        {"half a version of CIM", withBody(versions("2", "2.0", "1.0")), "501", "unsupported-cim-version"},
        {"an empty version of CIM", withBody(versions("", "2.0", "1.0")), "501", "unsupported-cim-version"},
        {"another version of the DTD", withBody(versions("2.0", "1.0", "1.0")), "501", "unsupported-dtd-version"},
        {"another protocol", withBody(versions("2.0", "2.0", "2.0")), "501", "unsupported-protocol-version"},
        {"a protocol of a later time", withBody(versions("2.0", "2.0", "10.0")), "501", "unsupported-protocol-version"},
        {"a protocol that no header says", withBody(versions("2.0", "2.0", "1.4")), "400", "header-mismatch"},
        {"CIM without a message", withBody(cim("")), "400", notValid},
        {"a declaration", withBody(cim("<DECLARATION/>")), "400", notValid},
        {"a message without ID", withBody(cim("<MESSAGE PROTOCOLVERSION='1.0'>" + simple + "</MESSAGE>")), "400",
         notValid},
        {"a message without a version", withBody(cim("<MESSAGE ID='1'>" + simple + "</MESSAGE>")), "400", notValid},
        {"an unknown attribute",
         withBody(cim("<MESSAGE ID='1' PROTOCOLVERSION='1.0' OTHER=''>" + simple + "</MESSAGE>")), "400", notValid},
        {"several requests", withBody(message("<MULTIREQ>" + simple + simple + "</MULTIREQ>")), "501",
         "multiple-requests-unsupported"},
        {"an empty message", withBody(message("")), "400", notValid},
        {"a message of text", withBody(message("text")), "400", notValid},
        {"two requests", withBody(message(simple + simple)), "400", notValid},
        {"an answer", withBody(message("<SIMPLERSP/>")), "400", notValid},
        {"an export", withBody(message("<SIMPLEEXPREQ/>")), "400", notValid},
        {"a request for nothing", withBody(message("<SIMPLEREQ/>")), "400", notValid},
        {"a request for two things", withBody(message("<SIMPLEREQ>" + call + call + "</SIMPLEREQ>")), "400", notValid},
        {"a request for an export", withBody(message("<SIMPLEREQ><EXPMETHODCALL NAME='A'/></SIMPLEREQ>")), "400",
         notValid},
    };
}

HostileRequests calls() {
    const auto method = [](const std::string& target) {
        return withBody(message("<SIMPLEREQ><METHODCALL NAME='A'>" + target + "</METHODCALL></SIMPLEREQ>"));
    };
    return {
        {"a call without a name",
         withBody(message("<SIMPLEREQ><IMETHODCALL>" + localNameSpace + "</IMETHODCALL></SIMPLEREQ>")), "400",
         notValid},
        {"a call of nothing", withBody(message("<SIMPLEREQ><IMETHODCALL NAME='GetClass'/></SIMPLEREQ>")), "400",
         notValid},
        {"a call without a namespace", withBody(intrinsic(parameter("A", text("1")), "")), "400", notValid},
        {"an empty namespace", withBody(intrinsic("", "<LOCALNAMESPACEPATH/>")), "400", notValid},
        {"a namespace of two in one",
         withBody(intrinsic("", "<LOCALNAMESPACEPATH><NAMESPACE NAME='root/cimv2'/></LOCALNAMESPACEPATH>")), "400",
         notValid},
        {"a namespace of another host", withBody(intrinsic("", "<NAMESPACEPATH/>")), "400", notValid},
        {"a parameter of a method", withBody(intrinsic("<PARAMVALUE NAME='A'/>")), "400", notValid},
        {"a parameter without a name", withBody(intrinsic("<IPARAMVALUE/>")), "400", notValid},
        {"a parameter with a type", withBody(intrinsic("<IPARAMVALUE NAME='A' PARAMTYPE='string'/>")), "400", notValid},
        {"a parameter that is no value", withBody(intrinsic(parameter("A", "<NAMESPACE NAME='a'/>"))), "400", notValid},
        {"a parameter of two values", withBody(intrinsic(parameter("A", text("1") + text("2")))), "400", notValid},
        {"a parameter of text", withBody(intrinsic(parameter("A", "text"))), "400", notValid},
        {"a key of an unknown kind",
         withBody(intrinsic(
             parameter("A", cimxml::instanceName("VESKA_ComputerSystem", cimxml::key("Name", "x", "datetime"))))),
         "400", notValid},
        {"a method of a class without a namespace", method(className("X")), "400", notValid},
        {"a method of a namespace", method(localNameSpace), "400", notValid},
    };
}

} // namespace

HostileRequests hostileBodies() {
    return together({characters(), markup(), envelopes(), calls()});
}

} // namespace endpoint
