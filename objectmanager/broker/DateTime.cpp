#include "objectmanager/broker/DateTime.h"

#include "objectmanager/broker/String.h"
#include "objectmanager/model/DateTime.h"

namespace om {

namespace {

/// Instants before 1970 come out as the two's complement of their distance. A text with asterisks has no instant.
CMPIUint64 getBinaryFormat(const CMPIDateTime* handle, CMPIStatus*) {
    const auto count = microseconds(open<DateTimeObject>(handle).text());
    if (!count) throw Failure{CMPI_RC_ERR_FAILED};
    return static_cast<CMPIUint64>(*count);
}

CMPIString* getStringFormat(const CMPIDateTime* handle, CMPIStatus*) {
    const auto& self = open<DateTimeObject>(handle);
    return partString(self, self.text());
}

bool isIntervalSlot(const CMPIDateTime* handle, CMPIStatus*) {
    return isInterval(open<DateTimeObject>(handle).text());
}

constexpr CMPIDateTimeFT makeTable() {
    auto ft = emptyTable<CMPIDateTimeFT>();
    ft.release = Slot<&releaseObject<DateTimeObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<DateTimeObject>, FaultKind::clone>();
    ft.getBinaryFormat = Slot<&getBinaryFormat, FaultKind::getBinaryFormat>();
    ft.getStringFormat = Slot<&getStringFormat, FaultKind::getStringFormat>();
    ft.isInterval = Slot<&isIntervalSlot, FaultKind::isInterval>();
    return ft;
}

} // namespace

const CMPIDateTimeFT DateTimeObject::table = makeTable();

void DateTimeObject::clear() noexcept {
    invalidate();
    text_ = std::string();
}

} // namespace om
