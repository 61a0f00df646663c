#include "objectmanager/cimxml/Message.h"

#include "objectmanager/cimxml/Writer.h"

#include <algorithm>
#include <array>

namespace cimxml {
namespace {

constexpr std::string_view beginning = "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n"
                                       "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">";

/// Indexed by status.
constexpr std::array<const char*, 29> names = {"",
                                               "FAILED",
                                               "ACCESS_DENIED",
                                               "INVALID_NAMESPACE",
                                               "INVALID_PARAMETER",
                                               "INVALID_CLASS",
                                               "NOT_FOUND",
                                               "NOT_SUPPORTED",
                                               "CLASS_HAS_CHILDREN",
                                               "CLASS_HAS_INSTANCES",
                                               "INVALID_SUPERCLASS",
                                               "ALREADY_EXISTS",
                                               "NO_SUCH_PROPERTY",
                                               "TYPE_MISMATCH",
                                               "QUERY_LANGUAGE_NOT_SUPPORTED",
                                               "INVALID_QUERY",
                                               "METHOD_NOT_AVAILABLE",
                                               "METHOD_NOT_FOUND",
                                               "",
                                               "",
                                               "NAMESPACE_NOT_EMPTY",
                                               "INVALID_ENUMERATION_CONTEXT",
                                               "INVALID_OPERATION_TIMEOUT",
                                               "PULL_HAS_BEEN_ABANDONED",
                                               "PULL_CANNOT_BE_ABANDONED",
                                               "FILTERED_ENUMERATION_NOT_SUPPORTED",
                                               "CONTINUATION_ON_ERROR_NOT_SUPPORTED",
                                               "SERVER_LIMITS_EXCEEDED",
                                               "SERVER_IS_SHUTTING_DOWN"};

bool isKnown(int code) {
    return code > 0 && static_cast<std::size_t>(code) < names.size() && *names[static_cast<std::size_t>(code)] != '\0';
}

std::string oneLine(std::string_view text) {
    constexpr std::size_t longest = 2000;
    std::string line(text.substr(0, longest));
    std::replace_if(
        line.begin(), line.end(), [](char c) { return c == '\n' || c == '\r' || c == '\t'; }, ' ');
    // A character that was cut in two is left out whole.
    if (text.size() > longest && (static_cast<unsigned char>(text[longest]) & 0xC0U) == 0x80) {
        while (!line.empty() && (static_cast<unsigned char>(line.back()) & 0xC0U) == 0x80) line.pop_back();
        if (!line.empty()) line.pop_back();
    }
    return line;
}

} // namespace

std::string errorName(int code) {
    return std::string("CIM_ERR_") + names[isKnown(code) ? static_cast<std::size_t>(code) : 1];
}

Pieces response(const Request& request, Pieces content) {
    Writer before;
    before.raw(beginning);
    before.open("MESSAGE", {{"ID", request.id}, {"PROTOCOLVERSION", "1.0"}});
    before.open("SIMPLERSP");
    before.open(request.intrinsic ? "IMETHODRESPONSE" : "METHODRESPONSE", {{"NAME", request.name}});
    content.enclose(before.text(), request.intrinsic ? "</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>"
                                                     : "</METHODRESPONSE></SIMPLERSP></MESSAGE></CIM>");
    return content;
}

Pieces errorResponse(const Request& request, int code, std::string_view description) {
    const int sent = isKnown(code) ? code : CMPI_RC_ERR_FAILED;
    Writer writer;
    writer.empty("ERROR", {{"CODE", std::to_string(sent)},
                           {"DESCRIPTION", description.empty() ? errorName(sent) : oneLine(description)}});
    return response(request, writer.take());
}

} // namespace cimxml
