#pragma once

#include "tests/objectmanager/endpoint/HttpRequests.h"

#include <string>
#include <vector>

namespace endpoint {

/// What goes over the wire: a request with the length that it has, or bytes as they are.
struct Sent {
    Sent(const HttpRequest& request) : bytes(bytesOf(request)) {}
    Sent(std::string given) : bytes(std::move(given)) {}

    std::string bytes;
};

/// A request that no honest client sends, and what it gets.
struct HostileRequest {
    const char* what;
    Sent sent;
    const char* status = "400";     ///< "none" is a connection that ends without an answer
    const char* cimError = "none";  ///< the header
    const char* cimStatus = "none"; ///< the code of the element ERROR
    bool ends = false;              ///< the connection, as it does wherever the status is not 200
};

inline std::string repeated(const std::string& text, int times) {
    std::string all;
    for (int i = 0; i < times; ++i) all += text;
    return all;
}

using HostileRequests = std::vector<HostileRequest>;

inline HostileRequests together(std::initializer_list<HostileRequests> parts) {
    HostileRequests all;
    for (const HostileRequests& part : parts) all.insert(all.end(), part.begin(), part.end());
    return all;
}

/// Wrong request lines and headers.
HostileRequests hostileHeads();
/// Bodies that do not have the length that is said, or a wrong one.
HostileRequests hostileLengths();
/// Bodies that are no XML, or no request of one operation.
HostileRequests hostileBodies();
/// Requests that can be read, of operations that fail.
HostileRequests hostileOperations();
/// Requests that never arrive whole.
HostileRequests slowRequests();

} // namespace endpoint
