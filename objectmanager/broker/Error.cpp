#include "objectmanager/broker/Error.h"

#include "objectmanager/broker/Array.h"
#include "objectmanager/broker/Convert.h"
#include "objectmanager/broker/String.h"

namespace om {

namespace {

using Attributes = ErrorAttributes;
using Text = ErrorAttributes::Text;

/// Getter of a number, which comes as its own enumeration.
template <auto Member>
auto getCode(const CMPIError* handle, CMPIStatus*) {
    return open<ErrorObject>(handle).attributes.*Member;
}

template <Text Attributes::*Member>
CMPIString* getText(const CMPIError* handle, CMPIStatus*) {
    const auto& self = open<ErrorObject>(handle);
    const Text& value = self.attributes.*Member;
    return value ? partString(self, *value) : nullptr;
}

template <Value Attributes::*Member>
CMPIArray* getArray(const CMPIError* handle, CMPIStatus*) {
    const auto& self = open<ErrorObject>(handle);
    return give(self, self.attributes.*Member).value.array; // null for a null value
}

template <Text Attributes::*Member>
CMPIStatus setText(const CMPIError* handle, const char* value) {
    auto& self = open<ErrorObject>(handle);
    self.attributes.*Member = text(value);
    return status(CMPI_RC_OK);
}

template <Value Attributes::*Member>
CMPIStatus setArray(const CMPIError* handle, const CMPIArray* array) {
    auto& self = open<ErrorObject>(handle);
    const auto& given = open<ArrayObject>(array);
    if (storedType(given.declaredType) != CMPI_string) throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    self.attributes.*Member = Value{CMPI_stringA, given.elements};
    return status(CMPI_RC_OK);
}

CMPIStatus setErrorType(const CMPIError* handle, CMPIErrorType type) {
    open<ErrorObject>(handle).attributes.type = type;
    return status(CMPI_RC_OK);
}

CMPIStatus setErrorSourceFormat(const CMPIError* handle, CMPIErrorSrcFormat format) {
    open<ErrorObject>(handle).attributes.sourceFormat = format;
    return status(CMPI_RC_OK);
}

constexpr void fillGetters(CMPIErrorFT& ft) {
    ft.getErrorType = Slot<&getCode<&Attributes::type>>();
    ft.getOtherErrorType = Slot<&getText<&Attributes::otherType>>();
    ft.getOwningEntity = Slot<&getText<&Attributes::owner>>();
    ft.getMessageID = Slot<&getText<&Attributes::messageId>>();
    ft.getMessage = Slot<&getText<&Attributes::message>>();
    ft.getPerceivedSeverity = Slot<&getCode<&Attributes::severity>>();
    ft.getProbableCause = Slot<&getCode<&Attributes::cause>>();
    ft.getProbableCauseDescription = Slot<&getText<&Attributes::causeDescription>>();
    ft.getRecommendedActions = Slot<&getArray<&Attributes::recommendedActions>>();
    ft.getErrorSource = Slot<&getText<&Attributes::source>>();
    ft.getErrorSourceFormat = Slot<&getCode<&Attributes::sourceFormat>>();
    ft.getOtherErrorSourceFormat = Slot<&getText<&Attributes::otherSourceFormat>>();
    ft.getCIMStatusCode = Slot<&getCode<&Attributes::code>>();
    ft.getCIMStatusCodeDescription = Slot<&getText<&Attributes::codeDescription>>();
    ft.getMessageArguments = Slot<&getArray<&Attributes::messageArguments>>();
}

constexpr CMPIErrorFT makeTable() {
    auto ft = emptyTable<CMPIErrorFT>();
    ft.release = Slot<&releaseObject<ErrorObject>>();
    ft.clone = Slot<&cloneObject<ErrorObject>>();
    fillGetters(ft);
    ft.setErrorType = Slot<&setErrorType>();
    ft.setOtherErrorType = Slot<&setText<&Attributes::otherType>>();
    ft.setProbableCauseDescription = Slot<&setText<&Attributes::causeDescription>>();
    ft.setRecommendedActions = Slot<&setArray<&Attributes::recommendedActions>>();
    ft.setErrorSource = Slot<&setText<&Attributes::source>>();
    ft.setErrorSourceFormat = Slot<&setErrorSourceFormat>();
    ft.setOtherErrorSourceFormat = Slot<&setText<&Attributes::otherSourceFormat>>();
    ft.setCIMStatusCodeDescription = Slot<&setText<&Attributes::codeDescription>>();
    ft.setMessageArguments = Slot<&setArray<&Attributes::messageArguments>>();
    return ft;
}

} // namespace

const CMPIErrorFT ErrorObject::table = makeTable();

void ErrorObject::clear() noexcept {
    invalidate();
    attributes = ErrorAttributes();
}

} // namespace om
