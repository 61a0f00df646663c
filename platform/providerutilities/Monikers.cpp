#include "vk/ProviderUtilities.h"

#include "providerutilities/Cmpi.h"

#include <optional>

namespace VK {

namespace {

/// A key's value as a moniker has it; none for references, nulls and other kinds, and when `status` says failure.
std::optional<std::string> valueText(const CMPIData& key, CMPIStatus& status) {
    const CMPIValue& value = key.value;
    switch (key.type) {
    case CMPI_string:
    case CMPI_chars:
        if (const char* const text = Cmpi::textOf(key, status); text != nullptr) return text;
        return std::nullopt;
    case CMPI_boolean:
        return value.boolean != 0 ? "TRUE" : "FALSE";
    case CMPI_uint8:
        return std::to_string(value.uint8);
    case CMPI_uint16:
        return std::to_string(value.uint16);
    case CMPI_uint32:
        return std::to_string(value.uint32);
    case CMPI_uint64:
        return std::to_string(value.uint64);
    case CMPI_sint8:
        return std::to_string(value.sint8);
    case CMPI_sint16:
        return std::to_string(value.sint16);
    case CMPI_sint32:
        return std::to_string(value.sint32);
    case CMPI_sint64:
        return std::to_string(value.sint64);
    default:
        return std::nullopt;
    }
}

bool appendKey(const CMPIObjectPath* path, CMPICount index, Moniker& moniker) {
    CMPIStatus status = Cmpi::freshStatus();
    CMPIString* keyName = nullptr;
    const CMPIData key = path->ft->getKeyAt(path, index, &keyName, &status);
    if (Cmpi::isAbsent(status)) return true;
    if (!Cmpi::succeeded(status)) return false;
    if (!Cmpi::hasValue(key, status)) return true;
    const char* const name = Cmpi::textOf(keyName);
    if (name == nullptr) return false;
    if (const auto value = valueText(key, status)) moniker.addKey(name, *value);
    return Cmpi::succeeded(status);
}

} // namespace

bool ProviderUtilities::transformObjectPathToMoniker(const CMPIObjectPath* objectPath, Moniker& moniker) {
    if (!Cmpi::hasSlot(objectPath, &CMPIObjectPathFT::getKeyCount) ||
        !Cmpi::hasSlot(objectPath, &CMPIObjectPathFT::getKeyAt))
        return false;
    CMPIStatus status = Cmpi::freshStatus();
    const CMPICount count = objectPath->ft->getKeyCount(objectPath, &status);
    if (!Cmpi::succeeded(status)) return false;
    for (CMPICount i = 0; i < count; ++i) {
        if (!appendKey(objectPath, i, moniker)) return false;
    }
    return true;
}

bool ProviderUtilities::transformMonikerToObjectPath(Moniker& moniker, CMPIObjectPath** objectPath) {
    if (objectPath == nullptr || *objectPath == nullptr) return false;
    bool allTaken = true;
    std::string name;
    std::string value;
    for (unsigned int i = 0; i < moniker.getKeyCount(); ++i) {
        moniker.selectKey(i);
        if (moniker.getName(name) && moniker.getValue(value))
            allTaken = setKeyProperty(*objectPath, name.c_str(), value) && allTaken;
    }
    if (moniker.getKeyCount() > 0) moniker.selectKey(0);
    return allTaken;
}

} // namespace VK
