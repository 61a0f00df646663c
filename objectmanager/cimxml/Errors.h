#pragma once

#include <cmpidt.h>

#include <stdexcept>
#include <string>

namespace cimxml {

/// A message that is no CIM message: it is answered by the HTTP status and the header `CIMError` alone.
class Refusal : public std::runtime_error {
public:
    Refusal(unsigned httpStatus, std::string cimErrorValue, const std::string& detail)
        : std::runtime_error(detail), status(httpStatus), cimError(std::move(cimErrorValue)) {}

    unsigned status;
    std::string cimError; ///< empty: no such header
};

inline Refusal notWellFormed(const std::string& detail) {
    return {400, "request-not-well-formed", detail};
}
inline Refusal notValid(const std::string& detail) {
    return {400, "request-not-valid", detail};
}

/// An operation's failure, which is answered as an element ERROR.
class CimError : public std::runtime_error {
public:
    CimError(int status, const std::string& description) : std::runtime_error(description), code(status) {}

    int code;
};

} // namespace cimxml
