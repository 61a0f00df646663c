#include "objectmanager/broker/Instance.h"

#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Convert.h"
#include "objectmanager/broker/ObjectPath.h"
#include "objectmanager/model/Names.h"

#include <algorithm>

namespace om {

namespace {

CMPIData getProperty(const CMPIInstance* handle, const char* name, CMPIStatus* rc) {
    const auto& self = open<InstanceObject>(handle);
    return giveNamed(self, self.value().properties, name, rc);
}

CMPIData getPropertyAt(const CMPIInstance* handle, CMPICount index, CMPIString** name, CMPIStatus* rc) {
    const auto& self = open<InstanceObject>(handle);
    return giveAt(self, self.value().properties, index, name, rc);
}

CMPICount getPropertyCount(const CMPIInstance* handle, CMPIStatus*) {
    return static_cast<CMPICount>(open<InstanceObject>(handle).value().properties.size());
}

CMPIStatus setProperty(const CMPIInstance* handle, const char* name, const CMPIValue* value, CMPIType type) {
    open<InstanceObject>(handle).set(name, value, type);
    return status(CMPI_RC_OK);
}

// Where a property was declared is not kept.
CMPIStatus setPropertyWithOrigin(const CMPIInstance* handle, const char* name, const CMPIValue* value, CMPIType type,
                                 const char*) {
    return setProperty(handle, name, value, type);
}

CMPIObjectPath* getObjectPath(const CMPIInstance* handle, CMPIStatus*) {
    const auto& self = open<InstanceObject>(handle);
    Value path{CMPI_ref, std::make_shared<const ObjectPath>(self.completePath())};
    return &static_cast<PathObject&>(self.part(std::move(path)));
}

CMPIStatus setPropertyFilter(const CMPIInstance* handle, const char** properties, const char** keys) {
    open<InstanceObject>(handle).setFilter(properties, keys);
    return status(CMPI_RC_OK);
}

CMPIStatus setObjectPath(const CMPIInstance* handle, const CMPIObjectPath* path) {
    auto& self = open<InstanceObject>(handle);
    self.setPath(open<PathObject>(path).path);
    return status(CMPI_RC_OK);
}

constexpr CMPIInstanceFT makeTable() {
    auto ft = emptyTable<CMPIInstanceFT>();
    ft.release = Slot<&releaseObject<InstanceObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<InstanceObject>, FaultKind::clone>();
    ft.getProperty = Slot<&getProperty, FaultKind::getProperty>();
    ft.getPropertyAt = Slot<&getPropertyAt, FaultKind::getPropertyAt>();
    ft.getPropertyCount = Slot<&getPropertyCount, FaultKind::getPropertyCount>();
    ft.setProperty = Slot<&setProperty, FaultKind::setProperty>();
    ft.getObjectPath = Slot<&getObjectPath, FaultKind::getObjectPath>();
    ft.setPropertyFilter = Slot<&setPropertyFilter, FaultKind::setPropertyFilter>();
    ft.setObjectPath = Slot<&setObjectPath, FaultKind::setObjectPath>();
    ft.setPropertyWithOrigin = Slot<&setPropertyWithOrigin, FaultKind::setPropertyWithOrigin>();
    return ft;
}

} // namespace

const CMPIInstanceFT InstanceObject::table = makeTable();

InstanceObject::InstanceObject(Broker& broker, Instance value)
    : Object(broker), instance(std::move(value)), schemaClass(broker.schema().resolve(instance.path.className)) {}

void InstanceObject::set(const char* name, const CMPIValue* value, CMPIType type) {
    const std::string_view property = text(name);
    const PropertyDeclaration* declared = schemaClass == nullptr ? nullptr : schemaClass->findProperty(property);
    Value given = read(value, type);
    if (declared != nullptr) {
        if (type == CMPI_null) given.type = declared->type;
        if (given.type != declared->type) throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
    if (filter && !containsName(*filter, property)) return;
    putValue(instance.properties, property, std::move(given));
}

void InstanceObject::setPath(ObjectPath path) {
    instance.path = std::move(path);
    schemaClass = broker().schema().resolve(instance.path.className);
}

void InstanceObject::setFilter(const char** properties, const char** keys) {
    if (properties == nullptr) {
        filter.reset();
        return;
    }
    std::vector<std::string> names;
    for (; *properties != nullptr; ++properties) names.emplace_back(*properties);
    // Providers name the keys here so that they stay whatever the client asked for.
    for (; keys != nullptr && *keys != nullptr; ++keys) names.emplace_back(*keys);
    auto& list = instance.properties;
    list.erase(std::remove_if(list.begin(), list.end(),
                              [&names](const NamedValue& each) { return !containsName(names, each.first); }),
               list.end());
    filter = std::move(names);
}

ObjectPath InstanceObject::completePath() const {
    ObjectPath path = instance.path;
    if (schemaClass == nullptr) return path;
    for (const PropertyDeclaration* key : schemaClass->keys) {
        if (findValue(path.keys, key->name) != nullptr) continue;
        const Value* property = findValue(instance.properties, key->name);
        if (property != nullptr && !property->isNull()) path.keys.emplace_back(key->name, *property);
    }
    return path;
}

Instance InstanceObject::complete() const {
    return {completePath(), instance.properties};
}

void InstanceObject::clear() noexcept {
    invalidate();
    instance = Instance();
}

} // namespace om
