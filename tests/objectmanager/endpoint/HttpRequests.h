#pragma once

#include "objectmanager/endpoint/Exchange.h"
#include "tests/objectmanager/cimxml/Messages.h"

#include <algorithm>
#include <string>

/// Requests as clients send them, and ones that differ from those in one thing.
namespace endpoint {

/// An intrinsic operation in root/cimv2.
inline HttpRequest asking(const std::string& operation, const std::string& parameters) {
    HttpRequest made;
    made.method = "POST";
    made.headers = {{"Host", "node7:5988"},
                    {"Content-Type", "application/xml; charset=\"utf-8\""},
                    {"CIMOperation", "MethodCall"},
                    {"CIMMethod", operation},
                    {"CIMObject", "root%2Fcimv2"}};
    made.body = cimxml::intrinsic(operation, parameters);
    return made;
}

/// One that is answered.
inline HttpRequest goodRequest() {
    return asking("EnumerateClassNames", cimxml::parameter("ClassName", cimxml::className("CIM_System")));
}

inline HttpRequest with(const std::string& name, const std::string& value, HttpRequest made = goodRequest()) {
    for (auto& [key, old] : made.headers) {
        if (key != name) continue;
        old = value;
        return made;
    }
    made.headers.emplace_back(name, value);
    return made;
}

/// The header stands there once more.
inline HttpRequest withMore(const std::string& name, const std::string& value) {
    HttpRequest made = goodRequest();
    made.headers.emplace_back(name, value);
    return made;
}

inline HttpRequest without(const std::string& name) {
    HttpRequest made = goodRequest();
    made.headers.erase(
        std::remove_if(made.headers.begin(), made.headers.end(), [&](const auto& each) { return each.first == name; }),
        made.headers.end());
    return made;
}

inline HttpRequest withBody(const std::string& body) {
    HttpRequest made = goodRequest();
    made.body = body;
    return made;
}

inline HttpRequest like(const std::string& method, const std::string& path, const std::string& version = "HTTP/1.1") {
    HttpRequest made = goodRequest();
    made.method = method;
    made.path = path;
    made.version = version;
    return made;
}

/// With all the headers of an M-POST, which `man` declares.
inline HttpRequest mandatory(const std::string& man) {
    HttpRequest made = goodRequest();
    made.method = "M-POST";
    for (auto& [name, value] : made.headers) {
        if (name.rfind("CIM", 0) == 0) name.insert(0, "40-");
    }
    made.headers.emplace_back("Man", man);
    return made;
}

/// Up to the body.
inline std::string headOf(const HttpRequest& request) {
    std::string text = request.method + ' ' + request.path + ' ' + request.version + "\r\n";
    for (const auto& [name, value] : request.headers) text += name + ": " + value + "\r\n";
    return text + "\r\n";
}

/// On the wire, with the length that its body has.
inline std::string bytesOf(HttpRequest request) {
    request.headers.emplace_back("Content-Length", std::to_string(request.body.size()));
    return headOf(request) + request.body;
}

} // namespace endpoint
