#pragma once

#include "objectmanager/model/Schema.h"
#include "objectmanager/model/Values.h"
#include "objectmanager/vkcim/Report.h"

#include <string>
#include <string_view>
#include <vector>

/// Answers as JSON: one object on one line, without the line's end.
namespace vkcim {

/// `nameSpace` is the request's: references that lie in another one carry it.
std::string jsonText(const om::Answer& answer, const std::string& nameSpace, const om::Schema& schema);
std::string jsonText(const Report& report, const std::string& nameSpace, const om::Schema& schema);
/// The bare value, without its type.
std::string jsonText(const om::Value& value, const std::string& nameSpace, const om::Schema& schema);
std::string jsonString(std::string_view text);
std::string jsonStrings(const std::vector<std::string>& texts);

} // namespace vkcim
