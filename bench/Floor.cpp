// A provider that knows nothing: it makes a prepared answer with the broker calls that this takes and no others. What
// it costs is the floor that no provider gets below with this broker.
#include "bench/Floor.h"

#include <cmpift.h>
#include <cmpimacs.h>

namespace {

const CMPIBroker* broker = nullptr;
const om::Answer* prepared = nullptr;

CMPIObjectPath* makePath(const om::ObjectPath& path);

CMPIType elementType(CMPIType type) {
    return static_cast<CMPIType>(type & ~CMPI_ARRAY);
}

/// A number, boolean, reference, or string or date-time object.
CMPIValue scalar(const om::Value& value) {
    CMPIValue made = {};
    switch (value.type) {
    case CMPI_boolean:
        made.boolean = std::get<bool>(value.data) ? 1 : 0;
        break;
    case CMPI_uint16:
        made.uint16 = static_cast<CMPIUint16>(std::get<std::uint64_t>(value.data));
        break;
    case CMPI_uint32:
        made.uint32 = static_cast<CMPIUint32>(std::get<std::uint64_t>(value.data));
        break;
    case CMPI_string:
        made.string = CMNewString(broker, std::get<std::string>(value.data).c_str(), nullptr);
        break;
    case CMPI_dateTime:
        made.dateTime = CMNewDateTimeFromChars(broker, std::get<std::string>(value.data).c_str(), nullptr);
        break;
    case CMPI_ref:
        made.ref = makePath(*std::get<std::shared_ptr<const om::ObjectPath>>(value.data));
        break;
    default:
        break;
    }
    return made;
}

CMPIValue array(const om::Value& value) {
    const auto& elements = std::get<std::vector<om::Value>>(value.data);
    const CMPIType type = elementType(value.type);
    CMPIValue made = {};
    made.array = CMNewArray(broker, static_cast<CMPICount>(elements.size()), type, nullptr);
    for (std::size_t i = 0; i < elements.size(); ++i) {
        const CMPIValue element = scalar(elements[i]);
        CMSetArrayElementAt(made.array, static_cast<CMPICount>(i), &element, type);
    }
    return made;
}

/// Hands a value to `set` in the cheapest way there is: a text goes as characters.
template <class Set>
void give(const om::Value& value, Set set) {
    if (value.type == CMPI_string) {
        set(reinterpret_cast<const CMPIValue*>(std::get<std::string>(value.data).c_str()), CMPI_chars);
        return;
    }
    const CMPIValue made = (value.type & CMPI_ARRAY) != 0 ? array(value) : scalar(value);
    set(&made, value.type);
}

CMPIObjectPath* makePath(const om::ObjectPath& path) {
    CMPIObjectPath* const made = CMNewObjectPath(broker, path.nameSpace.c_str(), path.className.c_str(), nullptr);
    for (const auto& [name, value] : path.keys) {
        const char* const key = name.c_str();
        give(value, [&](const CMPIValue* given, CMPIType type) { CMAddKey(made, key, given, type); });
    }
    return made;
}

CMPIInstance* makeInstance(const om::Instance& instance) {
    CMPIInstance* const made = CMNewInstance(broker, makePath(instance.path), nullptr);
    for (const auto& [name, value] : instance.properties) {
        const char* const property = name.c_str();
        give(value, [&](const CMPIValue* given, CMPIType type) { CMSetProperty(made, property, given, type); });
    }
    return made;
}

CMPIStatus answer(const CMPIResult* result) {
    for (const auto& each : prepared->results) {
        if (const auto* path = std::get_if<om::ObjectPath>(&each))
            CMReturnObjectPath(result, makePath(*path));
        else
            CMReturnInstance(result, makeInstance(std::get<om::Instance>(each)));
    }
    if (prepared->done) CMReturnDone(result);
    return {CMPI_RC_OK, nullptr};
}

CMPIStatus cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
    return {CMPI_RC_OK, nullptr};
}
CMPIStatus names(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*) {
    return answer(result);
}
CMPIStatus instances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*,
                     const char**) {
    return answer(result);
}

CMPIStatus cleanupAssociations(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean) {
    return {CMPI_RC_OK, nullptr};
}
CMPIStatus associators(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*,
                       const char*, const char*, const char*, const char*, const char**) {
    return answer(result);
}
CMPIStatus associatorNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*,
                           const char*, const char*, const char*, const char*) {
    return answer(result);
}

template <class Table>
constexpr Table emptyTable(const char* name) {
    Table table = {};
    table.ftVersion = 200;
    table.miVersion = 200;
    table.miName = name;
    return table;
}

} // namespace

extern "C" void Floor_Prepare(const om::Answer* answerToGive) {
    prepared = answerToGive;
}

extern "C" CMPIInstanceMI* Floor_Create_InstanceMI(const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*) {
    static CMPIInstanceMIFT table = [] {
        auto made = emptyTable<CMPIInstanceMIFT>("instanceFloor");
        made.cleanup = cleanup;
        made.enumerateInstanceNames = names;
        made.enumerateInstances = instances;
        made.getInstance = instances;
        return made;
    }();
    static CMPIInstanceMI mi = {nullptr, &table};
    broker = theBroker;
    return &mi;
}

extern "C" CMPIAssociationMI* Floor_Create_AssociationMI(const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*) {
    static CMPIAssociationMIFT table = [] {
        auto made = emptyTable<CMPIAssociationMIFT>("associationFloor");
        made.cleanup = cleanupAssociations;
        made.associators = associators;
        made.associatorNames = associatorNames;
        return made;
    }();
    static CMPIAssociationMI mi = {nullptr, &table};
    broker = theBroker;
    return &mi;
}
