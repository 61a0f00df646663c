#pragma once

#include "objectmanager/model/Schema.h"
#include "objectmanager/model/Values.h"
#include "objectmanager/vkcim/Report.h"
#include "objectmanager/vkcim/Terminal.h"

#include <string>

/// Answers for people to read; may change, programs take JSON.
namespace vkcim {

struct TextStyle {
    const std::string& nameSpace; ///< the request's: paths that lie in another one carry it
    const om::Schema& schema;
    Look look = {};
};

std::string plainAnswer(const om::Answer& answer, const TextStyle& style);
std::string plainReport(const Report& report, const TextStyle& style);

/// The bare values of a property of all instances answered, one a line, an array's each on its own; no line for null.
std::string plainValues(const om::Answer& answer, const std::string& property, const TextStyle& style);

} // namespace vkcim
