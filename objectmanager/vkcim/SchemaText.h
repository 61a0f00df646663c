#pragma once

#include "objectmanager/model/Schema.h"

#include <string>

/// The schema for people to read.
namespace vkcim {

/// A parameter's type and direction: `boolean, in`.
std::string parameterText(const om::ParameterDeclaration& parameter);

/// A line for each class that a provider serves: name, kind and superclass.
std::string classesText(const om::Schema& schema);

/// What a class has: its properties and methods with their types and where on the host they come from, and the names of
/// what it inherits.
std::string classText(const om::ClassDeclaration& declared, const om::Schema& schema);

} // namespace vkcim
