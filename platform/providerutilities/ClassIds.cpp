#include "vk/ProviderUtilities.h"

#include "providerutilities/ClassTable.h"
#include "providerutilities/Cmpi.h"

namespace VK {

namespace {

bool isEmpty(const char* text) {
    return text == nullptr || *text == '\0';
}

bool isDerivedFrom(const CMPIBroker* broker, const std::string& nameSpace, const char* className, const char* base) {
    if (!Cmpi::hasService(broker, &CMPIBrokerEncFT::classPathIsA)) return false;
    const CMPIObjectPath* const path = ProviderUtilities::createObjectPath(broker, className, nameSpace);
    if (path == nullptr) return false;
    CMPIStatus status = Cmpi::freshStatus();
    const CMPIBoolean isA = broker->eft->classPathIsA(broker, path, base, &status);
    // Requests may name any class; some object managers return this error for one that they do not know.
    if (status.rc != CMPI_RC_ERR_INVALID_CLASS)
        Cmpi::noteUntold("areClassesRelated", __LINE__, "whether a class is derived from another", status);
    return Cmpi::succeeded(status) && isA != 0;
}

} // namespace

unsigned short ProviderUtilities::getClassId(const CMPIObjectPath* objectPath) {
    if (!Cmpi::hasSlot(objectPath, &CMPIObjectPathFT::getClassName)) return CLASS_ID_UNKNOWN;
    CMPIStatus status = Cmpi::freshStatus();
    const CMPIString* const name = objectPath->ft->getClassName(objectPath, &status);
    const char* const text = Cmpi::succeeded(status) ? Cmpi::textOf(name, status) : nullptr;
    if (text != nullptr) return findClassId(text);
    if (Cmpi::succeeded(status) || Cmpi::isAbsent(status)) status.rc = CMPI_RC_ERR_FAILED; // every path has a class
    Cmpi::noteUntold("getClassId", __LINE__, "the class of a path", status);
    return CLASS_ID_UNKNOWN;
}

unsigned short ProviderUtilities::getClassId(const char* className) {
    return findClassId(className);
}

bool ProviderUtilities::areClassesRelated(const CMPIBroker* broker, const std::string& nameSpace, const char* className,
                                          const char* otherClassName) {
    if (isEmpty(className) || isEmpty(otherClassName)) return false;
    return isDerivedFrom(broker, nameSpace, className, otherClassName) ||
           isDerivedFrom(broker, nameSpace, otherClassName, className);
}

} // namespace VK
