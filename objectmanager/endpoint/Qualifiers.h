#pragma once

#include "objectmanager/cimxml/Writer.h"
#include "objectmanager/model/QualifierTypes.h"
#include "objectmanager/model/Qualifiers.h"

#include <vector>

namespace endpoint {

/// Writes QUALIFIER.DECLARATION.
void writeQualifierType(cimxml::Writer& writer, const om::QualifierType& type);
/// Writes a QUALIFIER for each that a declaration carries itself, and for each that it inherits: `line` holds the
/// declaration's own first, and then those of the declarations that it overrides.
void writeQualifiers(cimxml::Writer& writer, const std::vector<const om::Qualifiers*>& line);

} // namespace endpoint
