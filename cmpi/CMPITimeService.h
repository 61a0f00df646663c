#pragma once

#include "Linux/TimeService.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_TimeService.
class CMPITimeService : public InstanceAdapter<CMPITimeService, TimeService> {
public:
    using InstanceAdapter::InstanceAdapter;
    using Data = TimeService;

    /// Changes the one property that can be changed, "AutomaticDSTAdjustment". "Region" is accepted and has no effect,
    /// on purpose. Never reports an error.
    void modifyInstance(const CMPIInstance* instance, const char** properties);

    /// Runs `ManageTime` (any other name, in any case: 17) and returns a CMPI return code: 0, 1 for a failed action, 4
    /// for unusable arguments. The host is touched only when every argument has been checked. `result` is not used.
    unsigned int invokeMethod(const char* methodName, const CMPIArgs* in, CMPIArgs* out, const CMPIResult* result);

    static constexpr char className[] = "VESKA_TimeService";
    static constexpr char adapterName[] = "CMPITimeService";
    static constexpr char destructorName[] = "~CMPITimeService";
    static const TraceSource& traceSource();

    static constexpr Key<Data> keys[] = {
        {"Name", &Data::getName},
        {"CreationClassName", &Data::getCreationClassName},
        {"SystemName", &Data::getSystemName},
        {"SystemCreationClassName", &Data::getSystemCreationClassName},
    };

    static constexpr KeyFilter<Data> keyFilters[] = {
        {"Name", "name", Data::FilterType{}},
        {"SystemName", "systemName", Data::FilterType{}},
    };

    static constexpr Property<Data> properties[] = {
        {"SystemCreationClassName", &Data::getSystemCreationClassName},
        {"SystemName", &Data::getSystemName},
        {"CreationClassName", &Data::getCreationClassName},
        {"Name", &Data::getName},
        {"AutomaticDSTAdjustment", &Data::getAutomaticDSTAdjustment},
        {"Region", &Data::getRegion},
    };

private:
    unsigned int setTime(const CMPIArgs* in, CMPIArgs* out);
};

} // namespace VK::BaseServerProvider
