#include "objectmanager/broker/Enumeration.h"

#include "objectmanager/broker/Array.h"
#include "objectmanager/broker/Convert.h"

namespace om {

namespace {

/// The code of the end of an enumeration; older headers have no name for it.
constexpr auto noMoreElements = static_cast<CMPIrc>(18);

CMPIData getNext(const CMPIEnumeration* handle, CMPIStatus* rc) {
    auto& self = open<EnumerationObject>(handle);
    if (self.next >= self.elements.size()) {
        report(rc, noMoreElements);
        return noData();
    }
    return give(self, self.elements[self.next++]);
}

bool hasNext(const CMPIEnumeration* handle, CMPIStatus*) {
    const auto& self = open<EnumerationObject>(handle);
    return self.next < self.elements.size();
}

/// All elements, also those that were read already.
CMPIArray* toArray(const CMPIEnumeration* handle, CMPIStatus*) {
    const auto& self = open<EnumerationObject>(handle);
    const auto type = static_cast<CMPIType>(self.elementType | CMPI_ARRAY);
    return &static_cast<ArrayObject&>(self.part({type, self.elements}));
}

constexpr CMPIEnumerationFT makeTable() {
    auto ft = emptyTable<CMPIEnumerationFT>();
    ft.release = Slot<&releaseObject<EnumerationObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<EnumerationObject>, FaultKind::clone>();
    ft.getNext = Slot<&getNext, FaultKind::getNext>();
    ft.hasNext = Slot<&hasNext, FaultKind::hasNext>();
    ft.toArray = Slot<&toArray, FaultKind::toArray>();
    return ft;
}

} // namespace

const CMPIEnumerationFT EnumerationObject::table = makeTable();

void EnumerationObject::clear() noexcept {
    invalidate();
    elements = std::vector<Value>();
}

} // namespace om
