#include "objectmanager/broker/Args.h"
#include "objectmanager/broker/Array.h"
#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Convert.h"
#include "objectmanager/broker/DateTime.h"
#include "objectmanager/broker/Error.h"
#include "objectmanager/broker/Inspect.h"
#include "objectmanager/broker/Instance.h"
#include "objectmanager/broker/Messages.h"
#include "objectmanager/broker/ObjectPath.h"
#include "objectmanager/broker/String.h"
#include "objectmanager/model/DateTime.h"
#include "objectmanager/model/TypeNames.h"

namespace om {

namespace {

// A class that the schema lacks is taken: the provider knows better. Only no class at all is refused.
CMPIInstance* newInstance(const CMPIBroker* handle, const CMPIObjectPath* path, CMPIStatus*) {
    Broker& broker = open(handle);
    const ObjectPath& given = open<PathObject>(path).path;
    if (given.className.empty()) throw Failure{CMPI_RC_ERR_NOT_FOUND};
    return &make<InstanceObject>(broker, Instance{given, {}});
}

std::string orEmpty(const char* chars) {
    return chars == nullptr ? "" : chars;
}

CMPIObjectPath* newObjectPath(const CMPIBroker* handle, const char* nameSpace, const char* className, CMPIStatus*) {
    return &make<PathObject>(open(handle), ObjectPath{"", orEmpty(nameSpace), orEmpty(className), {}});
}

CMPIArgs* newArgs(const CMPIBroker* handle, CMPIStatus*) {
    return &make<ArgsObject>(open(handle));
}

CMPIString* newStringSlot(const CMPIBroker* handle, const char* chars, CMPIStatus*) {
    Broker& broker = open(handle);
    return newString(broker, text(chars));
}

CMPIArray* newArray(const CMPIBroker* handle, CMPICount size, CMPIType type, CMPIStatus*) {
    Broker& broker = open(handle);
    const CMPIType element = elementType(type);
    if (!isValueType(element)) throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    if (size > ArrayObject::mostElements) throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return &make<ArrayObject>(broker, size, element);
}

CMPIDateTime* newDateTime(const CMPIBroker* handle, CMPIStatus*) {
    return &make<DateTimeObject>(open(handle), formatNow());
}

/// What cannot be written in 25 characters is refused. Instants before 1970 are two's complements.
CMPIDateTime* newDateTimeFromBinary(const CMPIBroker* handle, CMPIUint64 count, CMPIBoolean interval, CMPIStatus*) {
    Broker& broker = open(handle);
    auto dateTime = interval != 0 ? formatInterval(count) : formatInstant(static_cast<std::int64_t>(count));
    if (!dateTime) throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return &make<DateTimeObject>(broker, std::move(*dateTime));
}

CMPIDateTime* newDateTimeFromChars(const CMPIBroker* handle, const char* chars, CMPIStatus*) {
    Broker& broker = open(handle);
    if (!isDateTime(text(chars))) throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return &make<DateTimeObject>(broker, chars);
}

CMPISelectExp* newSelectExp(const CMPIBroker* handle, const char*, const char*, CMPIArray** projection, CMPIStatus*) {
    open(handle);
    if (projection != nullptr) *projection = nullptr;
    throw Failure{CMPI_RC_ERR_NOT_SUPPORTED};
}

bool classPathIsA(const CMPIBroker* handle, const CMPIObjectPath* path, const char* className, CMPIStatus*) {
    const Schema& schema = open(handle).schema();
    const ObjectPath& given = open<PathObject>(path).path;
    return schema.isA(given.className, text(className));
}

CMPIString* toString(const CMPIBroker* handle, const void* object, CMPIStatus*) {
    Broker& broker = open(handle);
    return newString(broker, describeObject(object));
}

bool isOfType(const CMPIBroker* handle, const void* object, const char* typeName, CMPIStatus*) {
    open(handle);
    return typeNameOf(object) == std::string_view(text(typeName));
}

CMPIString* getType(const CMPIBroker* handle, const void* object, CMPIStatus*) {
    Broker& broker = open(handle);
    return newString(broker, typeNameOf(object));
}

// Writes nothing: the object manager's output holds only its answer, and a provider has a log of its own.
CMPIStatus noMessages(const CMPIBroker* handle, int, const char*, const char* chars, const CMPIString* string) {
    open(handle);
    if (chars == nullptr) open<StringObject>(string);
    return status(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIError* newCMPIError(const CMPIBroker* handle, const char* owner, const char* messageId, const char* message,
                        CMPIErrorSeverity severity, CMPIErrorProbableCause cause, CMPIrc code, CMPIStatus*) {
    Broker& broker = open(handle);
    const auto given = [](const char* chars) {
        return chars == nullptr ? ErrorAttributes::Text() : ErrorAttributes::Text(chars);
    };
    ErrorAttributes attributes;
    attributes.owner = given(owner);
    attributes.messageId = given(messageId);
    attributes.message = given(message);
    attributes.severity = severity;
    attributes.cause = cause;
    attributes.code = code;
    return &make<ErrorObject>(broker, std::move(attributes));
}

// There are no translations: every message is its default text.
CMPIStatus openMessageFile(const CMPIBroker* handle, const char*, CMPIMsgFileHandle* file) {
    open(handle);
    if (file == nullptr) throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    *file = nullptr;
    return status(CMPI_RC_ERR_NOT_FOUND);
}

CMPIStatus closeMessageFile(const CMPIBroker* handle, CMPIMsgFileHandle file) {
    open(handle);
    return status(file == nullptr ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
}

constexpr CMPIBrokerEncFT makeTable() {
    auto ft = emptyTable<CMPIBrokerEncFT>();
    ft.newInstance = Slot<&newInstance, FaultKind::newInstance>();
    ft.newObjectPath = Slot<&newObjectPath, FaultKind::newObjectPath>();
    ft.newArgs = Slot<&newArgs, FaultKind::newArgs>();
    ft.newString = Slot<&newStringSlot, FaultKind::newString>();
    ft.newArray = Slot<&newArray, FaultKind::newArray>();
    ft.newDateTime = Slot<&newDateTime, FaultKind::newDateTime>();
    ft.newDateTimeFromBinary = Slot<&newDateTimeFromBinary, FaultKind::newDateTimeFromBinary>();
    ft.newDateTimeFromChars = Slot<&newDateTimeFromChars, FaultKind::newDateTimeFromChars>();
    ft.newSelectExp = Slot<&newSelectExp>();
    ft.classPathIsA = Slot<&classPathIsA, FaultKind::classPathIsA>();
    ft.toString = Slot<&toString, FaultKind::toString>();
    ft.isOfType = Slot<&isOfType, FaultKind::isOfType>();
    ft.getType = Slot<&getType, FaultKind::getType>();
    ft.getMessage = &getMessage;
    ft.logMessage = Slot<&noMessages>();
    ft.trace = Slot<&noMessages>();
    ft.newCMPIError = Slot<&newCMPIError, FaultKind::newCMPIError>();
    ft.openMessageFile = Slot<&openMessageFile>();
    ft.closeMessageFile = Slot<&closeMessageFile>();
    ft.getMessage2 = &getMessage2;
    return ft;
}

} // namespace

const CMPIBrokerEncFT factoryTable = makeTable();

} // namespace om
