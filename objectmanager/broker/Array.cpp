#include "objectmanager/broker/Array.h"

#include "objectmanager/broker/Convert.h"

namespace om {

namespace {

CMPICount getSize(const CMPIArray* handle, CMPIStatus*) {
    return static_cast<CMPICount>(open<ArrayObject>(handle).elements.size());
}

CMPIType getSimpleType(const CMPIArray* handle, CMPIStatus*) {
    return open<ArrayObject>(handle).declaredType;
}

CMPIData getElementAt(const CMPIArray* handle, CMPICount index, CMPIStatus*) {
    const auto& self = open<ArrayObject>(handle);
    if (index >= self.elements.size()) throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
    return give(self, self.elements[index]);
}

CMPIStatus setElementAt(const CMPIArray* handle, CMPICount index, const CMPIValue* value, CMPIType type) {
    auto& self = open<ArrayObject>(handle);
    if (index >= self.elements.size()) throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
    if (type == CMPI_null) {
        self.elements[index] = Value{storedType(self.declaredType), {}};
        return status(CMPI_RC_OK);
    }
    // As strict object managers do: text for an array of strings must be made a string first.
    if (type != self.declaredType) throw Failure{CMPI_RC_ERR_TYPE_MISMATCH};
    self.elements[index] = read(value, type);
    return status(CMPI_RC_OK);
}

constexpr CMPIArrayFT makeTable() {
    auto ft = emptyTable<CMPIArrayFT>();
    ft.release = Slot<&releaseObject<ArrayObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<ArrayObject>, FaultKind::clone>();
    ft.getSize = Slot<&getSize, FaultKind::getSize>();
    ft.getSimpleType = Slot<&getSimpleType, FaultKind::getSimpleType>();
    ft.getElementAt = Slot<&getElementAt, FaultKind::getElementAt>();
    ft.setElementAt = Slot<&setElementAt, FaultKind::setElementAt>();
    return ft;
}

} // namespace

const CMPIArrayFT ArrayObject::table = makeTable();

ArrayObject::ArrayObject(Broker& broker, CMPICount size, CMPIType type)
    : Object(broker), declaredType(type), elements(size, Value{storedType(type), {}}) {}

ArrayObject::ArrayObject(Broker& broker, CMPIType elementType, std::vector<Value> values)
    : Object(broker), declaredType(elementType), elements(std::move(values)) {}

void ArrayObject::clear() noexcept {
    invalidate();
    elements = std::vector<Value>();
}

} // namespace om
