#include "provider/OperationFrame.h"

#include "vk/CmpiSlots.h"

namespace VK::BaseServerProvider {
namespace {

constexpr CMPIStatus notOffered = {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};

} // namespace

void Answer::add(const CMPIObjectPath* path) {
    if (path == nullptr) return;
    empty = false;
    note(Cmpi::hasSlot(result, &CMPIResultFT::returnObjectPath) ? CMReturnObjectPath(result, path) : notOffered);
}

void Answer::add(const CMPIInstance* instance) {
    if (instance == nullptr) return;
    empty = false;
    note(Cmpi::hasSlot(result, &CMPIResultFT::returnInstance) ? CMReturnInstance(result, instance) : notOffered);
}

void Answer::add(unsigned int returnValue) {
    CMPIValue value = {};
    value.uint32 = returnValue;
    empty = false;
    note(Cmpi::hasSlot(result, &CMPIResultFT::returnData) ? CMReturnData(result, &value, CMPI_uint32) : notOffered);
}

void Answer::close() {
    const CMPIStatus status = Cmpi::hasSlot(result, &CMPIResultFT::returnDone) ? CMReturnDone(result) : notOffered;
    if (!empty) note(status);
}

void Answer::note(const CMPIStatus& status) const {
    if (status.rc != CMPI_RC_OK)
        traceMessage(frame.here(), "The object manager refused a part of the answer", FailureLevel);
}

} // namespace VK::BaseServerProvider
