#include "cmpi/CMPICIMServiceConfig.h"
#include "cmpi/CMPIComputerSystem.h"
#include "cmpi/CMPIComputerSystemPackage.h"
#include "cmpi/CMPIElementCapabilities.h"
#include "cmpi/CMPIEnabledLogicalElementCapabilities.h"
#include "cmpi/CMPIPhysicalPackage.h"
#include "cmpi/CMPIServiceAffectsElement.h"
#include "cmpi/CMPITimeService.h"
#include "provider/OperationFrame.h"
#include "vk/ClassId.h"
#include "vk/ProviderUtilities.h"

namespace VK::BaseServerProvider {
namespace {

/// What an operation does with a class.
enum Service : unsigned {
    NotServed = 0,
    Open = 1,           ///< served; the result is not closed
    Done = 2,           ///< served; the result is closed with CMReturnDone
    DoneTracingEach = 3 ///< the same, and 'classId' is traced for every path that is returned
};

struct Request {
    const OperationFrame& frame;
    const CMPIContext* context;
    Answer& answer;
    const CMPIObjectPath* ref;
    const char** properties;
    unsigned short classId;
    Service service;

    /// To be called while the adapter lives: administrators read the lines of its end as the end of the answer.
    void closeIfDone() const {
        if (service != Open) answer.close();
    }
};

template <class Adapter>
void walkNames(const Request& request) {
    Adapter adapter(broker, request.context, request.ref);
    for (; adapter; ++adapter) {
        const CMPIObjectPath* const path = adapter.getObjectPath();
        if (path != nullptr && request.service == DoneTracingEach) request.frame.traceClassId(request.classId);
        request.answer.add(path);
    }
    request.closeIfDone();
}

template <class Adapter>
void walkInstances(const Request& request) {
    Adapter adapter(broker, request.context, request.ref);
    for (; adapter; ++adapter) request.answer.add(adapter.getCMPIInstance(request.properties));
    request.closeIfDone();
}

struct ClassRow {
    ClassId classId;
    void (*names)(const Request&);
    void (*instances)(const Request&);
    Service enumInstanceNames;
    Service enumInstances;
    Service getInstance;
};

template <class Adapter>
constexpr ClassRow row(ClassId classId, Service enumInstanceNames, Service enumInstances, Service getInstance) {
    return {classId, walkNames<Adapter>, walkInstances<Adapter>, enumInstanceNames, enumInstances, getInstance};
}

// Which class each operation serves, and whether it closes the result. The irregularities are kept on purpose because
// clients have come to depend on every one of them.
// clang-format off
constexpr ClassRow classRows[] = {
    //                                            class                                       EnumInstanceNames EnumInstances GetInstance
    row<CMPIComputerSystem>                       (ClassId::ComputerSystem,                    DoneTracingEach,  Done,         Done),
    row<CMPIPhysicalPackage>                      (ClassId::PhysicalPackage,                   Done,             Done,         Done),
    row<CMPIEnabledLogicalElementCapabilities>    (ClassId::EnabledLogicalElementCapabilities, Done,             Open,         Done),
    row<CMPIComputerSystemPackage>                (ClassId::ComputerSystemPackage,             Open,             Open,         Open),
    row<CMPIElementCapabilities>                  (ClassId::ComputerCapabilities,              Done,             Open,         Open),
    row<CMPITimeService>                          (ClassId::TimeService,                       Open,             Open,         Done),
    row<CMPITimeServiceAffectsElement>            (ClassId::TimeServiceAffectsElement,         Open,             Open,         NotServed),
    row<CMPICIMServiceConfig>                     (ClassId::CIMServiceConfig,                  Open,             Open,         Open),
};
// clang-format on

struct Column {
    Service ClassRow::*service;
    void (*ClassRow::*walk)(const Request&);
    bool traceUnserved; ///< whether 'classId' is traced once more for a class that is not served
};

constexpr Column enumInstanceNamesColumn = {&ClassRow::enumInstanceNames, &ClassRow::names, true};
constexpr Column enumInstancesColumn = {&ClassRow::enumInstances, &ClassRow::instances, true};
constexpr Column getInstanceColumn = {&ClassRow::getInstance, &ClassRow::instances, false};

/// The walk that the three reading operations share.
CMPIStatus serve(const OperationFrame& frame, const Column& column, const CMPIContext* context,
                 const CMPIResult* result, const CMPIObjectPath* ref, const char** properties) {
    return frame.runMarked([&](CMPIStatus& status) {
        const unsigned short classId = ProviderUtilities::getClassId(ref);
        frame.traceClassId(classId);
        const ClassRow* const classRow = findRow(classRows, classId);
        const Service service = classRow == nullptr ? NotServed : classRow->*column.service;
        if (service == NotServed) {
            if (column.traceUnserved) frame.traceClassId(classId);
            status.rc = CMPI_RC_ERR_INVALID_CLASS;
            return;
        }
        Answer answer(frame, result);
        (classRow->*column.walk)({frame, context, answer, ref, properties, classId, service});
    });
}

} // namespace

CMPIStatus BaseServer_EnumInstanceNames(CMPIInstanceMI*, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* ref) {
    return serve(OperationFrame(VK_PLACE()), enumInstanceNamesColumn, context, result, ref, nullptr);
}

CMPIStatus BaseServer_EnumInstances(CMPIInstanceMI*, const CMPIContext* context, const CMPIResult* result,
                                    const CMPIObjectPath* ref, const char** properties) {
    return serve(OperationFrame(VK_PLACE()), enumInstancesColumn, context, result, ref, properties);
}

CMPIStatus BaseServer_GetInstance(CMPIInstanceMI*, const CMPIContext* context, const CMPIResult* result,
                                  const CMPIObjectPath* ref, const char** properties) {
    return serve(OperationFrame(VK_PLACE()), getInstanceColumn, context, result, ref, properties);
}

CMPIStatus BaseServer_ModifyInstance(CMPIInstanceMI*, const CMPIContext* context, const CMPIResult*,
                                     const CMPIObjectPath* ref, const CMPIInstance* instance, const char** properties) {
    const OperationFrame frame(VK_PLACE());
    return frame.runMarked([&](CMPIStatus& status) {
        const unsigned short classId = ProviderUtilities::getClassId(ref);
        frame.traceClassId(classId);
        if (ClassId{classId} == ClassId::TimeService)
            CMPITimeService(broker, context, ref).modifyInstance(instance, properties);
        else
            status.rc = CMPI_RC_ERR_NOT_SUPPORTED;
    });
}

CMPIStatus BaseServer_CreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                     const CMPIInstance*) {
    return OperationFrame(VK_PLACE()).notSupported();
}

CMPIStatus BaseServer_DeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*) {
    return OperationFrame(VK_PLACE()).notSupported();
}

CMPIStatus BaseServer_ExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                const char*, const char*) {
    return OperationFrame(VK_PLACE()).notSupported();
}

} // namespace VK::BaseServerProvider
