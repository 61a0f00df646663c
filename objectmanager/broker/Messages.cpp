#include "objectmanager/broker/Messages.h"

#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/String.h"

#include <charconv>
#include <cstdarg>
#include <string>
#include <vector>

namespace om {

namespace {

constexpr CMPICount mostInserts = 10;

/// Variable arguments, in a struct so that they can be handed on.
struct Arguments {
    va_list list;
};

std::string real(double value) {
    char digits[32];
    const auto end = std::to_chars(digits, digits + sizeof digits, value).ptr;
    return std::string(digits, end);
}

/// The next pair of type code and value. The macros widen 32-bit numbers to long; only the type's width is looked at.
std::string nextInsert(Arguments& arguments) {
    switch (va_arg(arguments.list, int)) {
    case CMPI_sint32:
        return std::to_string(static_cast<CMPISint32>(va_arg(arguments.list, long)));
    case CMPI_uint32:
        return std::to_string(static_cast<CMPIUint32>(va_arg(arguments.list, unsigned long)));
    case CMPI_sint64:
        return std::to_string(va_arg(arguments.list, long long));
    case CMPI_uint64:
        return std::to_string(va_arg(arguments.list, unsigned long long));
    case CMPI_real64:
        return real(va_arg(arguments.list, double));
    case CMPI_boolean:
        return va_arg(arguments.list, int) != 0 ? "true" : "false";
    case CMPI_chars:
        return text(va_arg(arguments.list, const char*));
    case CMPI_string:
        return open<StringObject>(va_arg(arguments.list, const CMPIString*)).text();
    default:
        throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    }
}

/// Replaces `$0` to `$9`; one without a value stays.
std::string expand(const std::string& pattern, const std::vector<std::string>& inserts) {
    std::string result;
    for (std::size_t i = 0; i < pattern.size(); ++i) {
        const std::size_t number =
            i + 1 < pattern.size() ? static_cast<std::size_t>(pattern[i + 1] - '0') : mostInserts;
        if (pattern[i] == '$' && number < inserts.size()) {
            result += inserts[number];
            ++i;
        } else {
            result += pattern[i];
        }
    }
    return result;
}

std::vector<std::string> readInserts(CMPICount pairs, Arguments& arguments) {
    if (pairs > mostInserts) throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    std::vector<std::string> inserts;
    for (CMPICount i = 0; i < pairs; ++i) inserts.push_back(nextInsert(arguments));
    return inserts;
}

/// On an error the default text comes back as it is, with the error's code.
CMPIString* message(const CMPIBroker* handle, const char* defaultText, CMPIStatus* rc, CMPICount pairs,
                    Arguments* arguments) {
    Broker& broker = open(handle);
    std::string result = text(defaultText);
    try {
        result = expand(result, readInserts(pairs, *arguments));
    } catch (const Failure& failure) {
        report(rc, failure.code);
    }
    return newString(broker, std::move(result));
}

using Expand = Slot<&message, FaultKind::getMessage>;

} // namespace

CMPIString* getMessage(const CMPIBroker* broker, const char*, const char* defaultText, CMPIStatus* rc, CMPICount pairs,
                       ...) {
    Arguments arguments;
    va_start(arguments.list, pairs);
    CMPIString* result = Expand::call<CMPIString*>(broker, defaultText, rc, pairs, &arguments);
    va_end(arguments.list);
    return result;
}

CMPIString* getMessage2(const CMPIBroker* broker, const char*, CMPIMsgFileHandle, const char* defaultText,
                        CMPIStatus* rc, CMPICount pairs, ...) {
    Arguments arguments;
    va_start(arguments.list, pairs);
    CMPIString* result = Expand::call<CMPIString*>(broker, defaultText, rc, pairs, &arguments);
    va_end(arguments.list);
    return result;
}

} // namespace om
