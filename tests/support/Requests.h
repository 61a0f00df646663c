#pragma once

#include "support/Provider.h"

namespace test {

/// A request for that path, with nothing else said.
inline om::Request asking(om::Operation operation, const om::ObjectPath& path,
                          std::optional<std::string> assocClass = {}) {
    om::Request request;
    request.operation = operation;
    request.path = path;
    request.assocClass = std::move(assocClass);
    return request;
}

/// The same with a list of properties.
inline om::Request askingFor(const std::vector<std::string>& properties, om::Request request) {
    request.propertyList = properties;
    return request;
}

inline om::Request calling(const om::ObjectPath& path, const std::string& method, std::vector<om::NamedValue> in) {
    om::Request request = asking(om::Operation::InvokeMethod, path);
    request.method = method;
    request.values = std::move(in);
    return request;
}

/// The paths of an answer, one line each.
inline std::vector<std::string> printed(const om::Answer& answer) {
    std::vector<std::string> lines;
    for (const om::ObjectPath& path : paths(answer)) lines.push_back(print(path));
    return lines;
}

} // namespace test
