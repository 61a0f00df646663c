#include "vk/ProviderUtilities.h"

#include "providerutilities/Cmpi.h"

namespace VK {

namespace {

constexpr CMPIStatus unusable{CMPI_RC_ERR_INVALID_PARAMETER, nullptr};

bool refusedProperty(const char* name, const CMPIStatus& status) {
    return Cmpi::refused("setProperty", __LINE__, "the property", name, status);
}

bool set(CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type) {
    CMPIStatus status = unusable;
    if (name != nullptr && Cmpi::hasSlot(instance, &CMPIInstanceFT::setProperty))
        status = instance->ft->setProperty(instance, name, value, type);
    return Cmpi::succeeded(status) || refusedProperty(name, status);
}

/// One element of an array; null where the broker makes none.
CMPIString* makeString(const CMPIBroker* broker, const std::string& text, CMPIStatus& status) {
    status = unusable;
    if (!Cmpi::hasService(broker, &CMPIBrokerEncFT::newString)) return nullptr;
    status = Cmpi::freshStatus();
    CMPIString* const string = broker->eft->newString(broker, text.c_str(), &status);
    return Cmpi::isMade(string, status) ? string : nullptr;
}

CMPIArray* makeArray(const CMPIBroker* broker, std::size_t size, CMPIType elementType, CMPIStatus& status) {
    status = unusable;
    if (!Cmpi::hasService(broker, &CMPIBrokerEncFT::newArray)) return nullptr;
    status = Cmpi::freshStatus();
    CMPIArray* const array = broker->eft->newArray(broker, static_cast<CMPICount>(size), elementType, &status);
    return Cmpi::isMade(array, status) ? array : nullptr;
}

/// Sets an array property; `makeValue` turns an element into a value of that type, or fails its status.
template <typename Element, typename MakeValue>
bool setArray(const CMPIBroker* broker, CMPIInstance* instance, const char* name, const std::vector<Element>& elements,
              CMPIType elementType, MakeValue makeValue) {
    CMPIStatus status;
    CMPIArray* const array = makeArray(broker, elements.size(), elementType, status);
    if (!Cmpi::succeeded(status)) return refusedProperty(name, status);
    for (std::size_t i = 0; i < elements.size(); ++i) {
        const CMPIValue value = makeValue(elements[i], status);
        if (Cmpi::succeeded(status))
            status = Cmpi::hasSlot(array, &CMPIArrayFT::setElementAt)
                         ? array->ft->setElementAt(array, static_cast<CMPICount>(i), &value, elementType)
                         : unusable;
        if (!Cmpi::succeeded(status)) return refusedProperty(name, status);
    }
    CMPIValue value{};
    value.array = array;
    return set(instance, name, &value, static_cast<CMPIType>(CMPI_ARRAY | elementType));
}

/// For messages; null where the broker does not return one.
const char* classOf(const CMPIObjectPath* path) {
    if (!Cmpi::hasSlot(path, &CMPIObjectPathFT::getClassName)) return nullptr;
    CMPIStatus status = Cmpi::freshStatus();
    const CMPIString* const name = path->ft->getClassName(path, &status);
    return Cmpi::succeeded(status) ? Cmpi::textOf(name) : nullptr;
}

bool setDateTime(const CMPIBroker* broker, CMPIInstance* instance, const char* name, const std::string& text) {
    CMPIStatus status = unusable;
    CMPIValue value{};
    if (Cmpi::hasService(broker, &CMPIBrokerEncFT::newDateTimeFromChars)) {
        status = Cmpi::freshStatus();
        value.dateTime = broker->eft->newDateTimeFromChars(broker, text.c_str(), &status);
    }
    if (!Cmpi::isMade(value.dateTime, status)) return refusedProperty(name, status);
    return set(instance, name, &value, CMPI_dateTime);
}

} // namespace

CMPIInstance* ProviderUtilities::createInstance(const CMPIBroker* broker, CMPIObjectPath* objectPath) {
    if (objectPath == nullptr || !Cmpi::hasService(broker, &CMPIBrokerEncFT::newInstance)) return nullptr;
    CMPIStatus status = Cmpi::freshStatus();
    CMPIInstance* const instance = broker->eft->newInstance(broker, objectPath, &status);
    if (Cmpi::isMade(instance, status)) return instance;
    Cmpi::refused("createInstance", __LINE__, "an instance of the class", classOf(objectPath), status);
    return nullptr;
}

bool ProviderUtilities::setProperty(CMPIInstance* instance, const char* name, std::string& value) {
    return set(instance, name, Cmpi::asChars(value.c_str()), CMPI_chars);
}

bool ProviderUtilities::setProperty(CMPIInstance* instance, const char* name, bool value) {
    CMPIValue cmpi{};
    cmpi.boolean = value ? 1 : 0;
    return set(instance, name, &cmpi, CMPI_boolean);
}

bool ProviderUtilities::setProperty(CMPIInstance* instance, const char* name, float value) {
    CMPIValue cmpi{};
    cmpi.real32 = value;
    return set(instance, name, &cmpi, CMPI_real32);
}

bool ProviderUtilities::setProperty(CMPIInstance* instance, const char* name, unsigned int value) {
    CMPIValue cmpi{};
    cmpi.uint32 = value;
    return set(instance, name, &cmpi, CMPI_uint32);
}

bool ProviderUtilities::setProperty(CMPIInstance* instance, const char* name, unsigned short value) {
    CMPIValue cmpi{};
    cmpi.uint16 = value;
    return set(instance, name, &cmpi, CMPI_uint16);
}

bool ProviderUtilities::setProperty(CMPIInstance* instance, const char* name, CMPIObjectPath* value) {
    CMPIValue cmpi{};
    cmpi.ref = value;
    return value != nullptr ? set(instance, name, &cmpi, CMPI_ref) : refusedProperty(name, unusable);
}

bool ProviderUtilities::setProperty(const CMPIBroker* broker, CMPIInstance* instance, const char* name,
                                    std::string& value, bool dateTime) {
    return dateTime ? setDateTime(broker, instance, name, value) : setProperty(instance, name, value);
}

bool ProviderUtilities::setProperty(const CMPIBroker* broker, CMPIInstance* instance, const char* name,
                                    std::vector<std::string>& values) {
    // Some brokers take no CMPI_chars into an array of strings.
    return setArray(broker, instance, name, values, CMPI_string, [broker](const std::string& text, CMPIStatus& status) {
        CMPIValue value{};
        value.string = makeString(broker, text, status);
        return value;
    });
}

bool ProviderUtilities::setProperty(const CMPIBroker* broker, CMPIInstance* instance, const char* name,
                                    std::vector<unsigned short>& values) {
    return setArray(broker, instance, name, values, CMPI_uint16, [](unsigned short number, CMPIStatus&) {
        CMPIValue value{};
        value.uint16 = number;
        return value;
    });
}

} // namespace VK
