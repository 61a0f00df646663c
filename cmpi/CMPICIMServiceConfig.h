#pragma once

#include "Linux/CIMServiceConfig.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_CIMServiceConfig.
class CMPICIMServiceConfig : public InstanceAdapter<CMPICIMServiceConfig, CIMServiceConfig> {
public:
    using InstanceAdapter::InstanceAdapter;
    using Data = CIMServiceConfig;

    /// Runs `SetCIMconfig` (any other name, in any case: 17) and returns a CMPI return code: 0, 1 for a failed command,
    /// 4 without a usable argument. `out` and `result` are not used.
    unsigned int invokeMethod(const char* methodName, const CMPIArgs* in, CMPIArgs* out, const CMPIResult* result);

    /// Hands a request of the form name=value to the data class and returns its result.
    unsigned int executeMethod(std::string request);

    static constexpr char className[] = "VESKA_CIMServiceConfig";
    static constexpr char adapterName[] = "CMPICIMServiceConfig";
    static constexpr char destructorName[] = "~CMPICIMServiceConfig";
    static const TraceSource& traceSource();

    static constexpr Key<Data> keys[] = {
        {"Name", &Data::getName},
        {"CreationClassName", &Data::getCreationClassName},
    };

    static constexpr KeyFilter<Data> keyFilters[] = {
        {"Name", "name", Data::FilterType{}},
        {"CreationClassName", "creationClassName", Data::FilterType{}},
    };

    static constexpr Property<Data> properties[] = {
        {"Name", &Data::getName},
        {"CreationClassName", &Data::getCreationClassName},
        {"deliveryRetryIntervalSec", &Data::getIntervalParameter},
        {"deliveryRetryAttempts", &Data::getAttemptParameter},
    };
};

} // namespace VK::BaseServerProvider
