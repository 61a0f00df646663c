#pragma once

#include "objectmanager/cimxml/Elements.h"
#include "objectmanager/model/Schema.h"

#include <optional>

/// From texts to typed values.
namespace cimxml {

/// What decides a value's type where the message and the schema both say one.
enum class Trust {
    Schema, ///< of clients' requests: another type than the schema's is an error
    Message ///< of a server's answers, whose schema may be another one
};

/// What the texts of a message are read with.
struct Reading {
    const om::Schema& schema;
    std::string nameSpace; ///< of paths that name none
    Trust trust = Trust::Schema;
};

/// The type that a word such as `uint16` stands for.
std::optional<CMPIType> typeNamed(std::string_view word);
/// A type's word as TYPE and PARAMTYPE have it, of an array its elements'; `reference` for references.
std::string typeName(CMPIType type);

/// A value of that type; no element is a null. All of these throw CimError, with TYPE_MISMATCH for a text or an
/// element that does not fit the type, and INVALID_PARAMETER for paths that cannot be.
om::Value typedValue(const ValueElement& element, CMPIType type, const Reading& reading);
om::ObjectPath typedPath(const PathElement& element, const Reading& reading);
om::Instance typedInstance(const InstanceElement& element, const Reading& reading);

} // namespace cimxml
