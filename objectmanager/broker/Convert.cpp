#include "objectmanager/broker/Convert.h"

#include "objectmanager/broker/Array.h"
#include "objectmanager/broker/DateTime.h"
#include "objectmanager/broker/Instance.h"
#include "objectmanager/broker/ObjectPath.h"
#include "objectmanager/broker/String.h"
#include "objectmanager/model/Names.h"
#include "objectmanager/model/TypeNames.h"

namespace om {

namespace {

/// Reads the type's own bytes: callers pass the address of a plain scalar, too.
template <class T>
T take(const CMPIValue* value) {
    T result;
    std::memcpy(&result, static_cast<const void*>(value), sizeof result); // NOLINT(bugprone-sizeof-expression)
    return result;
}

template <class Stored, class T>
Value scalar(const CMPIValue* value, CMPIType type) {
    return {type, static_cast<Stored>(take<T>(value))};
}

/// The object in a value, or null.
template <class T>
T* object(const CMPIValue* value) {
    const auto* handle = take<const typename T::Handle*>(value);
    return handle == nullptr ? nullptr : &open<T>(handle);
}

Value readText(const char* chars) {
    if (chars == nullptr) return {CMPI_string, {}};
    return {CMPI_string, std::string(chars)};
}

Value readArray(const CMPIValue* value, CMPIType type) {
    const auto* array = object<ArrayObject>(value);
    if (array == nullptr) return {storedType(type), {}};
    if (storedType(array->declaredType) != storedType(elementType(type))) throw Failure{CMPI_RC_ERR_TYPE_MISMATCH};
    return {storedType(type), array->elements};
}

Value readObject(const CMPIValue* value, CMPIType type) {
    if (type == CMPI_string) {
        const auto* string = object<StringObject>(value);
        return string == nullptr ? Value{type, {}} : Value{type, string->text()};
    }
    if (type == CMPI_dateTime) {
        const auto* dateTime = object<DateTimeObject>(value);
        return dateTime == nullptr ? Value{type, {}} : Value{type, dateTime->text()};
    }
    if (type == CMPI_ref) {
        const auto* path = object<PathObject>(value);
        return path == nullptr ? Value{type, {}} : Value{type, std::make_shared<const ObjectPath>(path->path)};
    }
    const auto* instance = object<InstanceObject>(value);
    return instance == nullptr ? Value{type, {}} : Value{type, std::make_shared<const Instance>(instance->complete())};
}

Value readScalar(const CMPIValue* value, CMPIType type) {
    switch (type) {
    case CMPI_boolean:
        return {type, take<CMPIBoolean>(value) != 0};
    case CMPI_char16:
    case CMPI_uint16:
        return scalar<std::uint64_t, CMPIUint16>(value, type);
    case CMPI_uint8:
        return scalar<std::uint64_t, CMPIUint8>(value, type);
    case CMPI_uint32:
        return scalar<std::uint64_t, CMPIUint32>(value, type);
    case CMPI_uint64:
        return scalar<std::uint64_t, CMPIUint64>(value, type);
    case CMPI_sint8:
        return scalar<std::int64_t, CMPISint8>(value, type);
    case CMPI_sint16:
        return scalar<std::int64_t, CMPISint16>(value, type);
    case CMPI_sint32:
        return scalar<std::int64_t, CMPISint32>(value, type);
    case CMPI_sint64:
        return scalar<std::int64_t, CMPISint64>(value, type);
    case CMPI_real32:
        return scalar<double, CMPIReal32>(value, type);
    default:
        return scalar<double, CMPIReal64>(value, type);
    }
}

void giveScalar(CMPIValue& out, const Value& value) {
    const auto number = [&value] { return std::get<std::uint64_t>(value.data); };
    const auto integer = [&value] { return std::get<std::int64_t>(value.data); };
    switch (value.type) {
    case CMPI_boolean:
        out.boolean = std::get<bool>(value.data) ? 1 : 0;
        break;
    case CMPI_char16:
    case CMPI_uint16:
        out.uint16 = static_cast<CMPIUint16>(number());
        break;
    case CMPI_uint8:
        out.uint8 = static_cast<CMPIUint8>(number());
        break;
    case CMPI_uint32:
        out.uint32 = static_cast<CMPIUint32>(number());
        break;
    case CMPI_uint64:
        out.uint64 = number();
        break;
    case CMPI_sint8:
        out.sint8 = static_cast<CMPISint8>(integer());
        break;
    case CMPI_sint16:
        out.sint16 = static_cast<CMPISint16>(integer());
        break;
    case CMPI_sint32:
        out.sint32 = static_cast<CMPISint32>(integer());
        break;
    case CMPI_sint64:
        out.sint64 = integer();
        break;
    case CMPI_real32:
        out.real32 = static_cast<CMPIReal32>(std::get<double>(value.data));
        break;
    default:
        out.real64 = std::get<double>(value.data);
        break;
    }
}

void giveObject(CMPIValue& out, CMPIType type, Managed& part) {
    if (isArray(type)) {
        out.array = &static_cast<ArrayObject&>(part);
    } else if (type == CMPI_string) {
        out.string = &static_cast<StringObject&>(part);
    } else if (type == CMPI_dateTime) {
        out.dateTime = &static_cast<DateTimeObject&>(part);
    } else if (type == CMPI_ref) {
        out.ref = &static_cast<PathObject&>(part);
    } else {
        out.inst = &static_cast<InstanceObject&>(part);
    }
}

bool isObjectType(CMPIType type) {
    return (type & (CMPI_ENC | CMPI_ARRAY)) != 0;
}

} // namespace

CMPIType storedType(CMPIType type) {
    const CMPIType element = elementType(type);
    if (element != CMPI_chars && element != CMPI_charsptr) return type;
    return static_cast<CMPIType>(CMPI_string | (type & CMPI_ARRAY));
}

bool isValueType(CMPIType type) {
    switch (elementType(type)) {
    case CMPI_boolean:
    case CMPI_char16:
    case CMPI_uint8:
    case CMPI_uint16:
    case CMPI_uint32:
    case CMPI_uint64:
    case CMPI_sint8:
    case CMPI_sint16:
    case CMPI_sint32:
    case CMPI_sint64:
    case CMPI_real32:
    case CMPI_real64:
    case CMPI_string:
    case CMPI_chars:
    case CMPI_charsptr:
    case CMPI_dateTime:
    case CMPI_ref:
    case CMPI_instance:
        return true;
    default:
        return false;
    }
}

Value read(const CMPIValue* value, CMPIType type) {
    if (type == CMPI_null) return {};
    if (!isValueType(type)) throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    if (value == nullptr) return {storedType(type), {}};
    if (isArray(type)) return readArray(value, type);
    if (type == CMPI_chars) return readText(static_cast<const char*>(static_cast<const void*>(value)));
    if (type == CMPI_charsptr) return readText(take<const char*>(value));
    return isObjectType(type) ? readObject(value, type) : readScalar(value, type);
}

CMPIData give(const Managed& parent, const Value& value, CMPIValueState state) {
    CMPIData data = noData();
    data.type = value.type;
    data.state = state;
    if (value.isNull()) {
        data.state = static_cast<CMPIValueState>(state | CMPI_nullValue);
    } else if (isObjectType(value.type)) {
        giveObject(data.value, value.type, parent.part(value));
    } else {
        giveScalar(data.value, value);
    }
    return data;
}

std::unique_ptr<Managed> wrap(Broker& broker, Value value) {
    if (isArray(value.type)) {
        return std::make_unique<ArrayObject>(broker, elementType(value.type),
                                             std::move(std::get<std::vector<Value>>(value.data)));
    }
    switch (value.type) {
    case CMPI_string:
        return std::make_unique<StringObject>(broker, std::move(std::get<std::string>(value.data)));
    case CMPI_dateTime:
        return std::make_unique<DateTimeObject>(broker, std::move(std::get<std::string>(value.data)));
    case CMPI_ref:
        return std::make_unique<PathObject>(broker, *std::get<std::shared_ptr<const ObjectPath>>(value.data));
    default:
        return std::make_unique<InstanceObject>(broker, *std::get<std::shared_ptr<const Instance>>(value.data));
    }
}

CMPIData giveNamed(const Managed& parent, const std::vector<NamedValue>& list, const char* name, CMPIStatus* rc,
                   CMPIValueState state) {
    if (const Value* value = findValue(list, text(name))) return give(parent, *value, state);
    report(rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    return noData();
}

CMPIData giveAt(const Managed& parent, const std::vector<NamedValue>& list, CMPICount index, CMPIString** name,
                CMPIStatus* rc, CMPIValueState state) {
    if (name != nullptr) *name = nullptr;
    if (index >= list.size()) {
        report(rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
        return noData();
    }
    const auto& [entryName, value] = list[index];
    if (name != nullptr) *name = partString(parent, entryName);
    return give(parent, value, state);
}

} // namespace om
