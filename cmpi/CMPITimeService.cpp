#include "cmpi/CMPITimeService.h"

#include "vk/CmpiSlots.h"

#include <cmpimacs.h>

#include <cstdlib>

#include <strings.h>

namespace VK::BaseServerProvider {

static const std::string& loggerCMPITimeService = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPITimeService, "CMPITimeService"};

const TraceSource& CMPITimeService::traceSource() {
    return source;
}

void CMPITimeService::modifyInstance(const CMPIInstance* instance, const char** propertyList) {
    const ParameterTraceScope scope(VK_SCOPE(source), " referenceInstance=", instance, " properties=", propertyList);
    if (instance == nullptr) return;
    bool automatic{};
    unsigned short region{};
    if (ProviderUtilities::getProperty(instance, "AutomaticDSTAdjustment", automatic))
        data.setAutomaticDSTAdjustment(automatic); // on purpose: its result is ignored
    else
        ProviderUtilities::getProperty(instance, "Region", region); // on purpose: accepted and ignored
}

namespace {

using Cmpi::hasService;
using Cmpi::hasSlot;

/// An argument's data; of type CMPI_null when it is missing.
CMPIData argument(const CMPIArgs* in, const char* name) {
    if (!hasSlot(in, &CMPIArgsFT::getArg)) return {};
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIData data = in->ft->getArg(in, name, &status);
    return status.rc == CMPI_RC_OK ? data : CMPIData{};
}

/// Refuses an argument of the wrong type. The status with its message stays here on purpose: the caller sees the
/// code alone.
unsigned int refuse(const CMPIBroker* broker, const char* message) {
    CMPIStatus status = {CMPI_RC_ERR_INVALID_PARAMETER, nullptr};
    if (hasService(broker, &CMPIBrokerEncFT::newString)) status.msg = CMNewString(broker, message, nullptr);
    static_cast<void>(status);
    return CMPI_RC_ERR_FAILED;
}

/// Returns the host's time now, in "TimeData".
unsigned int returnCurrentTime(const CMPIBroker* broker, CMPIArgs* out) {
    if (!hasService(broker, &CMPIBrokerEncFT::newDateTime) || !hasSlot(out, &CMPIArgsFT::addArg))
        return CMPI_RC_ERR_FAILED;
    CMPIValue now = {};
    now.dateTime = CMNewDateTime(broker, nullptr);
    if (now.dateTime == nullptr || now.dateTime->hdl == nullptr) return CMPI_RC_ERR_FAILED;
    return out->ft->addArg(out, "TimeData", &now, CMPI_dateTime).rc == CMPI_RC_OK ? CMPI_RC_OK : CMPI_RC_ERR_FAILED;
}

/// The 25 characters of a date-time; false where the broker does not return them.
bool textOf(const CMPIDateTime* dateTime, std::string& text) {
    if (!hasSlot(dateTime, &CMPIDateTimeFT::getStringFormat)) return false;
    const CMPIString* string = dateTime->ft->getStringFormat(dateTime, nullptr);
    if (!hasSlot(string, &CMPIStringFT::getCharPtr)) return false;
    const char* characters = string->ft->getCharPtr(string, nullptr);
    if (characters == nullptr) return false;
    text = characters;
    return true;
}

/// Whole seconds since 1970-01-01 UTC; false where the broker knows none, as for a date-time with asterisks.
bool secondsOf(const CMPIDateTime* dateTime, long& seconds) {
    constexpr CMPIUint64 microsecondsPerSecond = 1000000;
    if (!hasSlot(dateTime, &CMPIDateTimeFT::getBinaryFormat)) return false;
    CMPIStatus status = {CMPI_RC_OK, nullptr}; // some brokers write it only on failure
    const CMPIUint64 microseconds = dateTime->ft->getBinaryFormat(dateTime, &status);
    if (status.rc != CMPI_RC_OK) return false;
    seconds = static_cast<long>(microseconds / microsecondsPerSecond);
    return true;
}

/// The minutes east of UTC that follow a date-time's sign; 0 without a sign, as in an interval.
unsigned int offsetOf(const std::string& text) {
    std::size_t sign = text.find('+');
    if (sign == std::string::npos) sign = text.find('-');
    long offset = 0;
    if (sign == std::string::npos)
        traceMessage(TracePoint(source, "invokeMethod"), "offset failed", FailureLevel);
    else
        offset = std::strtol(text.c_str() + sign, nullptr, 10);
    return static_cast<unsigned int>(offset);
}

} // namespace

unsigned int CMPITimeService::invokeMethod(const char* methodName, const CMPIArgs* in, CMPIArgs* out,
                                           const CMPIResult* result) {
    const ParameterTraceScope scope(VK_SCOPE(source), " methodName=", methodName, " in=", in, " out=", out,
                                    " result=", result);
    if (methodName == nullptr || strcasecmp(methodName, "ManageTime") != 0) return CMPI_RC_ERR_METHOD_NOT_FOUND;

    if (!hasSlot(in, &CMPIArgsFT::getArgCount)) return CMPI_RC_ERR_INVALID_PARAMETER;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPICount count = in->ft->getArgCount(in, &status);
    if (status.rc != CMPI_RC_OK || (count != 2 && count != 3)) return CMPI_RC_ERR_INVALID_PARAMETER;

    bool getRequest{};
    if (!ProviderUtilities::getProperty(in, "GetRequest", getRequest)) return CMPI_RC_ERR_INVALID_PARAMETER;
    if (argument(in, "ManagedElement").type != CMPI_ref) // its value does not matter: there is one time service
        return refuse(broker, "ManagedElement Parameter is having Invalid type or is NULL");
    return getRequest ? returnCurrentTime(broker, out) : setTime(in, out);
}

unsigned int CMPITimeService::setTime(const CMPIArgs* in, CMPIArgs* out) {
    const CMPIData timeData = argument(in, "TimeData");
    if (timeData.type != CMPI_dateTime) return refuse(broker, "TimeData Parameter is having Invalid type or is NULL");
    const CMPIDateTime* const time = CMIsNullValue(timeData) ? nullptr : timeData.value.dateTime;
    std::string text;
    if (time == nullptr || out == nullptr || !textOf(time, text)) return CMPI_RC_ERR_FAILED;
    const TracePoint here(source, "invokeMethod");
    traceVariable(here, "tmp_str", text.c_str());
    unsigned int gmtOffset = offsetOf(text);
    traceVariable(here, "CMPITIMESERVICE::gmt_offset_uint32", gmtOffset);

    long seconds{};
    if (!secondsOf(time, seconds) || data.manageTime(seconds, gmtOffset) != 0) return CMPI_RC_ERR_FAILED;
    return returnCurrentTime(broker, out);
}

} // namespace VK::BaseServerProvider
