#include "objectmanager/broker/ObjectPath.h"

#include "objectmanager/broker/Convert.h"
#include "objectmanager/broker/Describe.h"
#include "objectmanager/broker/String.h"
#include "objectmanager/model/Names.h"
#include "objectmanager/model/TypeNames.h"

namespace om {

namespace {

/// Setter and getter of one text of the path.
template <std::string ObjectPath::*Member>
CMPIStatus set(const CMPIObjectPath* handle, const char* value) {
    auto& self = open<PathObject>(handle);
    self.path.*Member = text(value);
    return status(CMPI_RC_OK);
}

template <std::string ObjectPath::*Member>
CMPIString* get(const CMPIObjectPath* handle, CMPIStatus*) {
    const auto& self = open<PathObject>(handle);
    return partString(self, self.path.*Member);
}

CMPIStatus addKey(const CMPIObjectPath* handle, const char* name, const CMPIValue* value, CMPIType type) {
    auto& self = open<PathObject>(handle);
    const char* key = text(name);
    if (type == CMPI_null || isArray(type) || type == CMPI_instance) {
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
    Value given = read(value, type);
    if (given.isNull()) throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    putValue(self.path.keys, key, std::move(given));
    return status(CMPI_RC_OK);
}

CMPIData getKey(const CMPIObjectPath* handle, const char* name, CMPIStatus* rc) {
    const auto& self = open<PathObject>(handle);
    return giveNamed(self, self.path.keys, name, rc, CMPI_keyValue);
}

CMPIData getKeyAt(const CMPIObjectPath* handle, CMPICount index, CMPIString** name, CMPIStatus* rc) {
    const auto& self = open<PathObject>(handle);
    return giveAt(self, self.path.keys, index, name, rc, CMPI_keyValue);
}

CMPICount getKeyCount(const CMPIObjectPath* handle, CMPIStatus*) {
    return static_cast<CMPICount>(open<PathObject>(handle).path.keys.size());
}

// The class stays: object managers in the field copy the namespace alone, and providers count on it.
CMPIStatus setNameSpaceFromObjectPath(const CMPIObjectPath* handle, const CMPIObjectPath* source) {
    auto& self = open<PathObject>(handle);
    self.path.nameSpace = open<PathObject>(source).path.nameSpace;
    return status(CMPI_RC_OK);
}

CMPIStatus setHostAndNameSpaceFromObjectPath(const CMPIObjectPath* handle, const CMPIObjectPath* source) {
    auto& self = open<PathObject>(handle);
    const auto& from = open<PathObject>(source).path;
    self.path.host = from.host;
    self.path.nameSpace = from.nameSpace;
    return status(CMPI_RC_OK);
}

template <class... Names>
CMPIData noQualifiers(const CMPIObjectPath* handle, Names..., CMPIStatus*) {
    open<PathObject>(handle);
    throw Failure{CMPI_RC_ERR_NOT_SUPPORTED};
}

using Name = const char*;

CMPIString* toString(const CMPIObjectPath* handle, CMPIStatus*) {
    const auto& self = open<PathObject>(handle);
    return partString(self, describe(self.path));
}

constexpr CMPIObjectPathFT makeTable() {
    auto ft = emptyTable<CMPIObjectPathFT>();
    ft.release = Slot<&releaseObject<PathObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<PathObject>, FaultKind::clone>();
    ft.setNameSpace = Slot<&set<&ObjectPath::nameSpace>, FaultKind::setNameSpace>();
    ft.getNameSpace = Slot<&get<&ObjectPath::nameSpace>, FaultKind::getNameSpace>();
    ft.setHostname = Slot<&set<&ObjectPath::host>, FaultKind::setHostname>();
    ft.getHostname = Slot<&get<&ObjectPath::host>, FaultKind::getHostname>();
    ft.setClassName = Slot<&set<&ObjectPath::className>, FaultKind::setClassName>();
    ft.getClassName = Slot<&get<&ObjectPath::className>, FaultKind::getClassName>();
    ft.addKey = Slot<&addKey, FaultKind::addKey>();
    ft.getKey = Slot<&getKey, FaultKind::getKey>();
    ft.getKeyAt = Slot<&getKeyAt, FaultKind::getKeyAt>();
    ft.getKeyCount = Slot<&getKeyCount, FaultKind::getKeyCount>();
    ft.setNameSpaceFromObjectPath = Slot<&setNameSpaceFromObjectPath, FaultKind::setNameSpaceFromObjectPath>();
    ft.setHostAndNameSpaceFromObjectPath =
        Slot<&setHostAndNameSpaceFromObjectPath, FaultKind::setHostAndNameSpaceFromObjectPath>();
    ft.getClassQualifier = Slot<&noQualifiers<Name>>();
    ft.getPropertyQualifier = Slot<&noQualifiers<Name, Name>>();
    ft.getMethodQualifier = Slot<&noQualifiers<Name, Name>>();
    ft.getParameterQualifier = Slot<&noQualifiers<Name, Name, Name>>();
    ft.toString = Slot<&toString, FaultKind::toString>();
    return ft;
}

} // namespace

const CMPIObjectPathFT PathObject::table = makeTable();

void PathObject::clear() noexcept {
    invalidate();
    path = ObjectPath();
}

} // namespace om
