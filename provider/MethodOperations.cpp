#include "cmpi/CMPICIMServiceConfig.h"
#include "cmpi/CMPITimeService.h"
#include "provider/OperationFrame.h"
#include "vk/ClassId.h"
#include "vk/CmpiSlots.h"
#include "vk/ProviderUtilities.h"

namespace VK::BaseServerProvider {
namespace {

struct Request {
    const OperationFrame& frame;
    const CMPIContext* context;
    const CMPIResult* result;
    const CMPIObjectPath* ref;
    const char* methodName;
    const CMPIArgs* in;
    CMPIArgs* out;
};

template <class Adapter>
unsigned int invoke(const Request& request, const char* methodName) {
    Adapter adapter(broker, request.context, request.ref);
    const unsigned int rc = adapter.invokeMethod(methodName, request.in, request.out, request.result);
    if (rc == 0) traceVariable(request.frame.here(), "returnCode", rc);
    return rc;
}

struct MethodRow {
    ClassId classId;
    unsigned int (*invoke)(const Request&, const char* methodName);
    const char* fixedName; ///< run whatever name was asked for
};

constexpr MethodRow methodRows[] = {
    // The name on purpose: every call on a time service runs this method.
    {ClassId::TimeService, invoke<CMPITimeService>, "ManageTime"},
    {ClassId::CIMServiceConfig, invoke<CMPICIMServiceConfig>, nullptr},
};

} // namespace

CMPIStatus BaseServer_InvokeMethod(CMPIMethodMI*, const CMPIContext* context, const CMPIResult* result,
                                   const CMPIObjectPath* ref, const char* methodName, const CMPIArgs* in,
                                   CMPIArgs* out) {
    const OperationFrame frame(VK_PLACE());
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    unsigned int returnCode = 0;

    const auto work = [&] {
        const MethodRow* const methodRow = findRow(methodRows, ProviderUtilities::getClassId(ref));
        if (methodRow == nullptr) {
            returnCode = CMPI_RC_ERR_INVALID_CLASS;
            status.rc = CMPI_RC_ERR_INVALID_CLASS;
            return;
        }
        const Request request = {frame, context, result, ref, methodName, in, out};
        const unsigned int rc =
            methodRow->invoke(request, methodRow->fixedName != nullptr ? methodRow->fixedName : methodName);
        if (rc != 0) {
            returnCode = rc;
            status.rc = static_cast<CMPIrc>(rc); // on purpose: one number is both
        }
    };
    frame.run([&] { withinLook(work); },
              [&](const std::exception& exception) {
                  const CMPIBroker* const theBroker = broker;
                  status.rc = CMPI_RC_ERR_FAILED;
                  if (Cmpi::hasService(theBroker, &CMPIBrokerEncFT::newString))
                      status.msg = CMNewString(theBroker, exception.what(), nullptr);
              });
    Answer answer(frame, result);
    contained([&] { answer.add(returnCode); });
    contained([&] { answer.close(); });
    return status; // on purpose: there is no exit marker here
}

} // namespace VK::BaseServerProvider
