#include "objectmanager/broker/Inspect.h"

#include "objectmanager/broker/Args.h"
#include "objectmanager/broker/Array.h"
#include "objectmanager/broker/Context.h"
#include "objectmanager/broker/DateTime.h"
#include "objectmanager/broker/Describe.h"
#include "objectmanager/broker/Enumeration.h"
#include "objectmanager/broker/Error.h"
#include "objectmanager/broker/Instance.h"
#include "objectmanager/broker/ObjectPath.h"
#include "objectmanager/broker/Result.h"
#include "objectmanager/broker/String.h"

namespace om {

namespace {

std::string describeKind(const StringObject& object) {
    return object.text();
}
std::string describeKind(const DateTimeObject& object) {
    return object.text();
}
std::string describeKind(const ArrayObject& object) {
    return describe(Value{CMPI_ARRAY, object.elements});
}
std::string describeKind(const PathObject& object) {
    return describe(object.path);
}
std::string describeKind(const InstanceObject& object) {
    return describe(object.value());
}
std::string describeKind(const ArgsObject& object) {
    return describe(object.values);
}
std::string describeKind(const EnumerationObject& object) {
    return describe(Value{CMPI_ARRAY, object.elements});
}
std::string describeKind(const ErrorObject& object) {
    return object.attributes.message.value_or("");
}
std::string describeKind(const ResultObject&) {
    return "result";
}
std::string describeKind(const ContextObject& object) {
    std::string result;
    for (const ContextEntry& entry : object.entries) {
        result += (result.empty() ? "" : ",") + entry.name + '=' + describe(entry.value);
    }
    return '{' + result + '}';
}

struct Kind {
    const void* table;
    const char* name;
    std::string (*describe)(const void* object);
};

template <class T>
Kind kind(const char* name) {
    return {&T::table, name,
            [](const void* object) { return describeKind(open<T>(static_cast<const typename T::Handle*>(object))); }};
}

const Kind& kindOf(const void* object) {
    static const Kind kinds[] = {
        kind<StringObject>("CMPIString"),     kind<ArrayObject>("CMPIArray"),
        kind<DateTimeObject>("CMPIDateTime"), kind<PathObject>("CMPIObjectPath"),
        kind<InstanceObject>("CMPIInstance"), kind<ArgsObject>("CMPIArgs"),
        kind<ContextObject>("CMPIContext"),   kind<EnumerationObject>("CMPIEnumeration"),
        kind<ResultObject>("CMPIResult"),     kind<ErrorObject>("CMPIError"),
    };
    if (object == nullptr) throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    const void* words[2]; // handle and function table, in every kind of object
    std::memcpy(words, object, sizeof words);
    for (const Kind& each : kinds) {
        if (words[0] != nullptr && words[1] == each.table) return each;
    }
    throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
}

} // namespace

const char* typeNameOf(const void* object) {
    return kindOf(object).name;
}

std::string describeObject(const void* object) {
    return kindOf(object).describe(object);
}

} // namespace om
