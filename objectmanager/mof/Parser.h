#pragma once

#include "objectmanager/model/Schema.h"

namespace mof {

/// The classes that a text declares, each as it stands there, values and defaults as literals. Everything else of MOF
/// is refused: a compiler may ignore a pragma, and instances and qualifier declarations do not belong into a schema
/// that is loaded over the standard one. Throws MofError.
std::vector<om::ClassDeclaration> parse(std::string_view text, const std::string& file);

} // namespace mof
