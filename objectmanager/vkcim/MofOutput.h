#pragma once

#include "objectmanager/model/Schema.h"
#include "objectmanager/model/Values.h"
#include "objectmanager/vkcim/Report.h"

#include <string>

/// Answers as MOF: instances as `instance of` blocks, paths one a line, return values and out arguments as comments.
namespace vkcim {

/// `nameSpace` is the request's: paths that lie in another one carry it.
std::string mofText(const om::Answer& answer, const std::string& nameSpace, const om::Schema& schema);
/// Comments name the class before each group, what it answered instead, and the notes.
std::string mofText(const Report& report, const std::string& nameSpace, const om::Schema& schema);

} // namespace vkcim
