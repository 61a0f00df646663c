#include "objectmanager/broker/Args.h"

#include "objectmanager/broker/Convert.h"
#include "objectmanager/model/Names.h"

namespace om {

namespace {

CMPIStatus addArg(const CMPIArgs* handle, const char* name, const CMPIValue* value, CMPIType type) {
    auto& self = open<ArgsObject>(handle);
    const char* argument = text(name);
    putValue(self.values, argument, read(value, type));
    return status(CMPI_RC_OK);
}

CMPIData getArg(const CMPIArgs* handle, const char* name, CMPIStatus* rc) {
    const auto& self = open<ArgsObject>(handle);
    return giveNamed(self, self.values, name, rc);
}

CMPIData getArgAt(const CMPIArgs* handle, CMPICount index, CMPIString** name, CMPIStatus* rc) {
    const auto& self = open<ArgsObject>(handle);
    return giveAt(self, self.values, index, name, rc);
}

CMPICount getArgCount(const CMPIArgs* handle, CMPIStatus*) {
    return static_cast<CMPICount>(open<ArgsObject>(handle).values.size());
}

constexpr CMPIArgsFT makeTable() {
    auto ft = emptyTable<CMPIArgsFT>();
    ft.release = Slot<&releaseObject<ArgsObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<ArgsObject>, FaultKind::clone>();
    ft.addArg = Slot<&addArg, FaultKind::addArg>();
    ft.getArg = Slot<&getArg, FaultKind::getArg>();
    ft.getArgAt = Slot<&getArgAt, FaultKind::getArgAt>();
    ft.getArgCount = Slot<&getArgCount, FaultKind::getArgCount>();
    return ft;
}

} // namespace

const CMPIArgsFT ArgsObject::table = makeTable();

void ArgsObject::clear() noexcept {
    invalidate();
    values = std::vector<NamedValue>();
}

} // namespace om
