#pragma once

#include <string>

/// Messages as clients send them.
namespace cimxml {

inline std::string cim(const std::string& content) {
    return "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">" + content +
           "</CIM>";
}

inline std::string message(const std::string& content) {
    return cim("<MESSAGE ID=\"4711\" PROTOCOLVERSION=\"1.0\">" + content + "</MESSAGE>");
}

inline const std::string localNameSpace =
    R"(<LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="cimv2"/></LOCALNAMESPACEPATH>)";

/// An intrinsic operation in root/cimv2.
inline std::string intrinsic(const std::string& name, const std::string& parameters,
                             const std::string& nameSpace = localNameSpace) {
    return message("<SIMPLEREQ><IMETHODCALL NAME=\"" + name + "\">" + nameSpace + parameters +
                   "</IMETHODCALL></SIMPLEREQ>");
}

inline std::string parameter(const std::string& name, const std::string& value) {
    return "<IPARAMVALUE NAME=\"" + name + "\">" + value + "</IPARAMVALUE>";
}

inline std::string className(const std::string& name) {
    return "<CLASSNAME NAME=\"" + name + "\"/>";
}

inline std::string text(const std::string& value) {
    return "<VALUE>" + value + "</VALUE>";
}

inline std::string key(const std::string& name, const std::string& value, const std::string& kind = "string") {
    return "<KEYBINDING NAME=\"" + name + "\"><KEYVALUE VALUETYPE=\"" + kind + "\">" + value +
           "</KEYVALUE></KEYBINDING>";
}

inline std::string instanceName(const std::string& name, const std::string& keys) {
    return "<INSTANCENAME CLASSNAME=\"" + name + "\">" + keys + "</INSTANCENAME>";
}

} // namespace cimxml
