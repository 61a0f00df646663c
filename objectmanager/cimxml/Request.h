#pragma once

#include "objectmanager/cimxml/Elements.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace cimxml {

struct ParameterElement {
    std::string name;
    std::string type; ///< PARAMTYPE; empty where the message has none
    ValueElement value;
};

/// One operation that a message asks for.
struct Request {
    std::string id;              ///< of the message, for the answer
    std::string protocolVersion; ///< as the message says it
    bool intrinsic = true;       ///< or a method of a class
    std::string name;
    std::string nameSpace;
    PathElement target; ///< of a method: what it is asked of
    std::vector<ParameterElement> parameters;
};

/// Reads a request. Throws Refusal for what is no valid request of one operation; several in one message are not
/// taken.
Request readRequest(std::string_view body);

} // namespace cimxml
