#pragma once

#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Managed.h"
#include "objectmanager/broker/Result.h"

#include <cmpimacs.h>

#include <gmock/gmock.h>

#include <string>
#include <type_traits>

namespace om {

/// A broker without a provider, and a call that owns what a test makes.
class BrokerFixture : public testing::Test {
protected:
    Broker owner{Schema::builtin(), "root/test"};
    Call call;
    const CMPIBroker* broker = owner.handle();
    CMPIStatus rc{CMPI_RC_ERR_FAILED, nullptr};

    CMPIString* string(const char* text) { return broker->eft->newString(broker, text, &rc); }
    CMPIObjectPath* path(const char* className) {
        return broker->eft->newObjectPath(broker, "root/test", className, &rc);
    }
    CMPIInstance* instance(const char* className) { return broker->eft->newInstance(broker, path(className), &rc); }
    CMPIArgs* args() { return broker->eft->newArgs(broker, &rc); }
    CMPIArray* array(CMPICount size, CMPIType type) { return broker->eft->newArray(broker, size, type, &rc); }
    CMPIDateTime* dateTime(const char* text) { return broker->eft->newDateTimeFromChars(broker, text, &rc); }
    CMPIContext* context() { return &make<ContextObject>(owner, usualEntries("root/test")); }
};

/// A text as CMPI_chars is passed, and the address of a plain variable.
inline const CMPIValue* chars(const char* text) {
    return reinterpret_cast<const CMPIValue*>(text);
}
template <class T>
const CMPIValue* at(const T& variable) {
    return reinterpret_cast<const CMPIValue*>(&variable);
}

inline std::string textOf(const CMPIString* string) {
    return string == nullptr ? "(null)" : string->ft->getCharPtr(string, nullptr);
}

/// Calls a slot with `first` and nulls for all else, the status excepted, and gives the code back that it reports.
template <class R, class First, class... A>
CMPIrc codeWithNulls(R (*slot)(First, A...), std::decay_t<First> first) {
    CMPIStatus rc{CMPI_RC_NEVER_UNLOAD, nullptr}; // no slot answers this
    const auto argument = [&rc](auto none) {
        if constexpr (std::is_same_v<decltype(none), CMPIStatus*>) {
            return &rc;
        } else {
            return none;
        }
    };
    if constexpr (std::is_same_v<R, CMPIStatus>) {
        return slot(first, argument(A{})...).rc;
    } else if constexpr (std::is_same_v<std::remove_cv_t<std::remove_pointer_t<First>>, std::remove_pointer_t<R>>) {
        R clone = slot(first, argument(A{})...); // only a clone is an object of the same kind
        if (clone != nullptr) clone->ft->release(clone);
        return rc.rc;
    } else {
        slot(first, argument(A{})...);
        return rc.rc;
    }
}

} // namespace om
