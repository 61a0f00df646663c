#include "cmpi/CMPICIMServiceConfig.h"

#include "vk/CmpiSlots.h"

#include <cstdio>

#include <strings.h>

namespace VK::BaseServerProvider {

static const std::string& loggerCMPICIMServiceConfig = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPICIMServiceConfig, "CMPICIMServiceConfig"};

const TraceSource& CMPICIMServiceConfig::traceSource() {
    return source;
}

unsigned int CMPICIMServiceConfig::invokeMethod(const char* methodName, const CMPIArgs* in, CMPIArgs* out,
                                                const CMPIResult* result) {
    const ParameterTraceScope scope(VK_SCOPE(source), " methodName=", methodName, " in=", in, " out=", out,
                                    " result=", result);
    if (methodName == nullptr || strcasecmp(methodName, "SetCIMconfig") != 0) return CMPI_RC_ERR_METHOD_NOT_FOUND;

    // The count itself does not matter.
    if (!Cmpi::hasSlot(in, &CMPIArgsFT::getArgCount)) return CMPI_RC_ERR_INVALID_PARAMETER;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    in->ft->getArgCount(in, &status);
    if (status.rc != CMPI_RC_OK) return CMPI_RC_ERR_INVALID_PARAMETER;

    struct Argument {
        const char* name;
        unsigned int value;
        bool given;
    };
    Argument arguments[] = {{"deliveryRetryIntervalSec", {}, {}}, {"deliveryRetryAttempts", {}, {}}};
    for (Argument& argument : arguments)
        argument.given = ProviderUtilities::getProperty(in, argument.name, argument.value);

    // In this order; the first failure ends it; otherwise the last setting's result is returned.
    unsigned int answer = CMPI_RC_ERR_INVALID_PARAMETER;
    for (const Argument& argument : arguments) {
        if (!argument.given) continue;
        char request[256] = {};
        // Signed on purpose, so that a value above 2147483647 goes out negative.
        std::snprintf(request, sizeof request, "%s%s%d", argument.name, "=", static_cast<int>(argument.value));
        answer = executeMethod(request) != 0 ? CMPI_RC_ERR_FAILED : CMPI_RC_OK;
        if (answer != CMPI_RC_OK) break;
    }
    return answer;
}

unsigned int CMPICIMServiceConfig::executeMethod(std::string request) {
    const TraceScope scope(VK_SCOPE(source));
    return data.executeCIMServiceConfig(request);
}

} // namespace VK::BaseServerProvider
