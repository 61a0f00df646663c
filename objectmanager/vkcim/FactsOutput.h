#pragma once

#include "objectmanager/vkcim/Facts.h"

namespace vkcim {

/// One flat JSON object on one line, without the line's end, as docs/json/vkcim-facts.schema.json describes it.
std::string factsText(const Facts& facts, const std::string& nameSpace, const om::Schema& schema);

} // namespace vkcim
