#include "vk/ProviderUtilities.h"

#include "providerutilities/Cmpi.h"

#include <strings.h>

namespace VK {

namespace {

constexpr char keysOfPath[] = "the keys of a path";
constexpr CMPIStatus notOffered{CMPI_RC_ERR_NOT_SUPPORTED, nullptr}; ///< by a broker that lacks a way of asking

CMPIData absent() {
    CMPIData data{};
    data.state = CMPI_nullValue | CMPI_notFound;
    return data;
}

/// For brokers that compare key names by case, and for those that count keys which nobody set.
CMPIData findKey(const CMPIObjectPath* path, const char* name) {
    const unsigned int count = ProviderUtilities::getKeyCount(path);
    for (unsigned int i = 0; i < count; ++i) {
        CMPIStatus status = Cmpi::freshStatus();
        CMPIString* keyName = nullptr;
        const CMPIData key = path->ft->getKeyAt(path, i, &keyName, &status);
        Cmpi::requireTold(status, keysOfPath);
        if (!Cmpi::hasValue(key, status)) continue;
        const char* const text = Cmpi::textOf(keyName, status);
        Cmpi::requireTold(status, keysOfPath);
        if (text != nullptr && strcasecmp(text, name) == 0) return key;
    }
    return absent();
}

CMPIData getKey(const CMPIObjectPath* path, const char* name) {
    if (path == nullptr || name == nullptr) return absent();
    CMPIStatus status = notOffered;
    if (Cmpi::hasSlot(path, &CMPIObjectPathFT::getKey)) {
        status = Cmpi::freshStatus();
        const CMPIData key = path->ft->getKey(path, name, &status);
        if (Cmpi::hasValue(key, status)) return key;
    }
    if (Cmpi::hasSlot(path, &CMPIObjectPathFT::getKeyAt) && Cmpi::hasSlot(path, &CMPIObjectPathFT::getKeyCount))
        return findKey(path, name);
    Cmpi::requireTold(status, keysOfPath);
    return absent();
}

bool addKey(CMPIObjectPath* path, const char* name, const CMPIValue* value, CMPIType type) {
    CMPIStatus status{CMPI_RC_ERR_INVALID_PARAMETER, nullptr};
    if (name != nullptr && Cmpi::hasSlot(path, &CMPIObjectPathFT::addKey))
        status = path->ft->addKey(path, name, value, type);
    return Cmpi::succeeded(status) || Cmpi::refused("setKeyProperty", __LINE__, "the key", name, status);
}

} // namespace

std::string ProviderUtilities::getNamespace(const CMPIObjectPath* objectPath) {
    if (!Cmpi::hasSlot(objectPath, &CMPIObjectPathFT::getNameSpace)) return {};
    CMPIStatus status = Cmpi::freshStatus();
    const CMPIString* const nameSpace = objectPath->ft->getNameSpace(objectPath, &status);
    const char* const text = Cmpi::succeeded(status) ? Cmpi::textOf(nameSpace, status) : nullptr;
    Cmpi::requireTold(status, "the namespace of a path");
    return text != nullptr ? text : "";
}

CMPIObjectPath* ProviderUtilities::createObjectPath(const CMPIBroker* broker, const char* className,
                                                    std::string nameSpace) {
    if (className == nullptr || !Cmpi::hasService(broker, &CMPIBrokerEncFT::newObjectPath)) return nullptr;
    CMPIStatus status = Cmpi::freshStatus();
    CMPIObjectPath* const path = broker->eft->newObjectPath(broker, nameSpace.c_str(), className, &status);
    if (Cmpi::isMade(path, status)) return path;
    Cmpi::refused("createObjectPath", __LINE__, "a path of the class", className, status);
    return nullptr;
}

unsigned int ProviderUtilities::getKeyCount(const CMPIObjectPath* objectPath) {
    if (objectPath == nullptr) return 0;
    CMPIStatus status = notOffered;
    CMPICount count{};
    if (Cmpi::hasSlot(objectPath, &CMPIObjectPathFT::getKeyCount)) {
        status = Cmpi::freshStatus();
        count = objectPath->ft->getKeyCount(objectPath, &status);
    }
    Cmpi::requireTold(status, keysOfPath);
    return Cmpi::succeeded(status) ? count : 0;
}

bool ProviderUtilities::getKeyProperty(const CMPIObjectPath* objectPath, const char* name, std::string& value) {
    const CMPIData key = getKey(objectPath, name);
    CMPIStatus status = Cmpi::freshStatus();
    const char* const text = (key.state & CMPI_nullValue) == 0 ? Cmpi::textOf(key, status) : nullptr;
    Cmpi::requireTold(status, keysOfPath);
    if (text == nullptr) return false;
    value = text;
    return true;
}

bool ProviderUtilities::getKeyProperty(const CMPIObjectPath* objectPath, const char* name, CMPIObjectPath** value) {
    const CMPIData key = getKey(objectPath, name);
    if ((key.state & CMPI_nullValue) != 0 || key.type != CMPI_ref || key.value.ref == nullptr || value == nullptr)
        return false;
    *value = key.value.ref;
    return true;
}

bool ProviderUtilities::setKeyProperty(CMPIObjectPath* objectPath, const char* name, const std::string& value) {
    return addKey(objectPath, name, Cmpi::asChars(value.c_str()), CMPI_chars);
}

bool ProviderUtilities::setKeyProperty(CMPIObjectPath* objectPath, const char* name, CMPIObjectPath* value) {
    CMPIValue reference{};
    reference.ref = value;
    return addKey(value != nullptr ? objectPath : nullptr, name, &reference, CMPI_ref);
}

} // namespace VK
