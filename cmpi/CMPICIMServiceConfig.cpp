#include "cmpi/CMPICIMServiceConfig.h"

#include <cstdio>

#include <strings.h>

namespace VK::BaseServerProvider {

static const std::string loggerCMPICIMServiceConfig("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPICIMServiceConfig, "CMPICIMServiceConfig"};

using Data = CIMServiceConfig;

const TraceSource& CMPICIMServiceConfig::traceSource() {
    return source;
}

const Key<Data> CMPICIMServiceConfig::keys[] = {
    {"Name", &Data::getName},
    {"CreationClassName", &Data::getCreationClassName},
};

const KeyFilter<Data> CMPICIMServiceConfig::keyFilters[] = {
    {"Name", "name", Data::FilterType{}},
    {"CreationClassName", "creationClassName", Data::FilterType{}},
};

const Property<Data> CMPICIMServiceConfig::properties[] = {
    {"Name", &Data::getName},
    {"CreationClassName", &Data::getCreationClassName},
    {"deliveryRetryIntervalSec", &Data::getIntervalParameter},
    {"deliveryRetryAttempts", &Data::getAttemptParameter},
};

unsigned int CMPICIMServiceConfig::invokeMethod(const char* methodName, const CMPIArgs* in, CMPIArgs* out,
                                                const CMPIResult* result) {
    const ParameterTraceScope scope(source, " methodName=", methodName, " in=", in, " out=", out, " result=", result);
    if (methodName == nullptr || strcasecmp(methodName, "SetCIMconfig") != 0) return CMPI_RC_ERR_METHOD_NOT_FOUND;

    CMPIStatus status = {CMPI_RC_OK, nullptr};
    if (in != nullptr) in->ft->getArgCount(in, &status); // the count itself does not matter
    if (in == nullptr || status.rc != CMPI_RC_OK) return CMPI_RC_ERR_INVALID_PARAMETER;

    // In this order; the first failure ends it, and otherwise the last setting's result is the answer.
    unsigned int answer = CMPI_RC_ERR_INVALID_PARAMETER;
    for (const char* name : {"deliveryRetryIntervalSec", "deliveryRetryAttempts"}) {
        unsigned int value = 0;
        if (!ProviderUtilities::getProperty(in, name, value)) continue;
        char request[256] = {};
        // Meant: signed, so that a value above 2147483647 goes out negative.
        std::snprintf(request, sizeof request, "%s%s%d", name, "=", static_cast<int>(value));
        answer = executeMethod(request) != 0 ? CMPI_RC_ERR_FAILED : CMPI_RC_OK;
        if (answer != CMPI_RC_OK) break;
    }
    return answer;
}

unsigned int CMPICIMServiceConfig::executeMethod(std::string request) {
    const TraceScope scope(source);
    return data.executeCIMServiceConfig(request);
}

} // namespace VK::BaseServerProvider
