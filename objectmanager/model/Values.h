#pragma once

#include <cmpidt.h>

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

/// The object manager's own view of CIM data: plain values that know nothing of function tables. The broker wraps
/// them in CMPI objects, the command line reads and prints them.
namespace om {

struct ObjectPath;
struct Instance;

/// A typed CIM value, perhaps null.
struct Value {
    /// A CMPI type code: that of a CIM type, CMPI_ref, CMPI_instance, or one of these with CMPI_ARRAY.
    CMPIType type = CMPI_null;

    /// monostate is null. boolean: bool; unsigned integers and char16: uint64_t; signed: int64_t; reals: double (a
    /// real32 holds a value that a float can hold); string and datetime (its 25 characters): string; references and
    /// embedded instances: a shared object that nobody changes; arrays: their elements, each of the element type.
    std::variant<std::monostate, bool, std::uint64_t, std::int64_t, double, std::string,
                 std::shared_ptr<const ObjectPath>, std::shared_ptr<const Instance>, std::vector<Value>>
        data;

    bool isNull() const { return std::holds_alternative<std::monostate>(data); }
};

using NamedValue = std::pair<std::string, Value>;

/// A path: namespace and class, then its keys in the order in which they were set. Names compare without regard to
/// case and keep their spelling.
struct ObjectPath {
    std::string host;
    std::string nameSpace;
    std::string className;
    std::vector<NamedValue> keys;
};

struct Instance {
    ObjectPath path;
    std::vector<NamedValue> properties;
};

/// Deep and exact: spellings, order and types count.
bool operator==(const Value& a, const Value& b);
bool operator==(const ObjectPath& a, const ObjectPath& b);
bool operator==(const Instance& a, const Instance& b);

using Result = std::variant<ObjectPath, Instance>;

/// What one operation answered.
struct Answer {
    CMPIrc code = CMPI_RC_OK;
    std::optional<std::string> message;
    bool done = false; ///< whether the provider closed the result
    std::vector<Result> results;
    std::optional<Value> returnValue;
    std::vector<NamedValue> out;
    bool faulted = false; ///< whether the fault that the request asked for happened
};

} // namespace om
