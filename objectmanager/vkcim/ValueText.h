#pragma once

#include "objectmanager/model/Schema.h"
#include "objectmanager/model/Values.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// Values as texts: `TYPE:TEXT` or TEXT alone, `null:TYPE`.
namespace vkcim {

/// Where a value stands: the namespace for references that name none, and the classes known.
struct ValueContext {
    const std::string& nameSpace;
    const om::Schema& schema;
    std::vector<std::string>* remarks = nullptr; ///< receives those of parsePath on references
};

/// Reads a value. Without a type of its own it takes `declared`; without that its look decides. The empty text is
/// the empty string. `offset` is where the text starts in the whole, for messages. Throws ParseError.
om::Value parseValue(std::string_view text, std::optional<CMPIType> declared, const ValueContext& context,
                     std::size_t offset = 0);

/// The type that the schema declares for a name, or nothing.
using DeclaredType = std::function<std::optional<CMPIType>(const std::string& name)>;

/// Reads `NAME=VALUE`. Throws ParseError.
om::NamedValue parseAssignment(std::string_view text, const DeclaredType& declaredType, const ValueContext& context);

/// The value as `TYPE:TEXT`, so that parseValue reads it back. An array's null elements are written `null`, and an
/// embedded instance as its path: these two cannot be read back.
std::string valueText(const om::Value& value, const ValueContext& context);

/// The value's text alone, without type and without escapes; `null` for null, elements separated by `, `.
std::string plainText(const om::Value& value, const ValueContext& context);

} // namespace vkcim
