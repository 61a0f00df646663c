#include "vk/ProviderUtilities.h"

#include "providerutilities/Cmpi.h"

namespace VK {

namespace {

/// Reads a named value of exactly that type through the slot that the object's kind has for it.
template <typename Object, typename Slot, typename Table, typename Member, typename Value>
bool read(const Object* object, Slot Table::*slot, const char* name, CMPIType type, Member CMPIValue::*member,
          Value& value) {
    if (name == nullptr || !Cmpi::hasSlot(object, slot)) return false;
    CMPIStatus status = Cmpi::freshStatus();
    const CMPIData data = (object->ft->*slot)(object, name, &status);
    Cmpi::noteUntold("getProperty", __LINE__, "a value that a request brings", status);
    if (!Cmpi::hasValue(data, status) || data.type != type) return false;
    value = static_cast<Value>(data.value.*member);
    return true;
}

} // namespace

bool ProviderUtilities::getProperty(const CMPIInstance* instance, const char* name, bool& value) {
    return read(instance, &CMPIInstanceFT::getProperty, name, CMPI_boolean, &CMPIValue::boolean, value);
}

bool ProviderUtilities::getProperty(const CMPIInstance* instance, const char* name, unsigned short& value) {
    return read(instance, &CMPIInstanceFT::getProperty, name, CMPI_uint16, &CMPIValue::uint16, value);
}

bool ProviderUtilities::getProperty(const CMPIArgs* arguments, const char* name, bool& value) {
    return read(arguments, &CMPIArgsFT::getArg, name, CMPI_boolean, &CMPIValue::boolean, value);
}

bool ProviderUtilities::getProperty(const CMPIArgs* arguments, const char* name, unsigned int& value) {
    return read(arguments, &CMPIArgsFT::getArg, name, CMPI_uint32, &CMPIValue::uint32, value);
}

} // namespace VK
