#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <string>
#include <string_view>

/// Requests as messages for a CIM server, and its answers.
namespace vkcim {

/// What is sent: the values of the headers, and the body.
struct RemoteQuestion {
    std::string method;
    std::string object; ///< percent-encoded
    std::string body;
};

RemoteQuestion remoteQuestion(const om::Request& request, const om::Schema& schema);

/// What a server answered; types are those that the message says. Throws std::runtime_error where it is no answer.
om::Answer remoteAnswer(std::string_view body, const om::Request& request, const om::Schema& schema);

} // namespace vkcim
