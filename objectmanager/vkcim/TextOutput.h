#pragma once

#include "objectmanager/model/Schema.h"
#include "objectmanager/model/Values.h"
#include "objectmanager/vkcim/Report.h"

#include <string>

/// Answers for people to read; may change, programs take JSON.
namespace vkcim {

struct TextStyle {
    const std::string& nameSpace; ///< the request's: paths that lie in another one carry it
    const om::Schema& schema;
    bool colours = false;
};

std::string plainAnswer(const om::Answer& answer, const TextStyle& style);
std::string plainReport(const Report& report, const TextStyle& style);

} // namespace vkcim
