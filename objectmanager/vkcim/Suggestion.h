#pragma once

#include "objectmanager/model/Schema.h"

#include <optional>
#include <string>
#include <string_view>

namespace vkcim {

/// The known class whose name comes nearest to `className`, for a name that the schema lacks; nothing when none is
/// near enough.
std::optional<std::string> nearestClass(std::string_view className, const om::Schema& schema);

} // namespace vkcim
