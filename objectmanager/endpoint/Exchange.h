#pragma once

#include "objectmanager/endpoint/Operations.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace endpoint {

using Headers = std::vector<std::pair<std::string, std::string>>;

struct HttpRequest {
    std::string method;
    std::string version = "HTTP/1.1";
    std::string path = "/cimom";
    Headers headers;
    std::string body;
};

struct HttpAnswer {
    unsigned status = 200;
    Headers headers;
    std::string body;    ///< empty unless the status is 200
    cimxml::Pieces rest; ///< what follows the body

    // For the log.
    std::string operation; ///< empty where the request was not read so far
    std::string nameSpace;
    std::string className; ///< empty where the operation has none
    int cimStatus = 0;
    std::string detail; ///< what was wrong with a request that is refused
};

/// What DSP0200 says of headers. Whether a request's head is one of a CIM operation; nothing where it is, so that the
/// body may be read.
std::optional<HttpAnswer> refuseHead(const HttpRequest& request);

/// Hears what a message asks, as an answer says it for the log, before it is carried out, and whether that changes
/// something; may look at the caller's rights anew, or throw.
using Permit = std::function<void(const HttpAnswer& asked, bool changes, Caller& caller)>;

/// The answer to a request whose head is not refused. `CIMObject` is compared leniently, since many clients do not
/// encode it: its namespace and class, encoded or not, whatever its keys. A body of up to `enough` bytes, or a little
/// more, is whole.
HttpAnswer exchange(Operations& operations, const HttpRequest& request, Caller caller, const Permit& permit = {},
                    std::size_t enough = std::numeric_limits<std::size_t>::max());

/// A header's value, of several of that name joined by commas; nothing where there is none. Names compare without
/// regard to case.
std::optional<std::string> headerOf(const HttpRequest& request, std::string_view name);

} // namespace endpoint
