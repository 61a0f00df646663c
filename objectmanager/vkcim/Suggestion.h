#pragma once

#include "objectmanager/model/Schema.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace vkcim {

/// The name that comes nearest to one that is not among the known; nothing when none is near enough.
std::optional<std::string> nearestName(std::string_view name, const std::vector<std::string>& known);

/// `; did you mean NAME?`, or nothing.
std::string didYouMean(const std::optional<std::string>& name);

/// The known class whose name comes nearest to `className`, for a name that the schema lacks; nothing when none is
/// near enough.
std::optional<std::string> nearestClass(std::string_view className, const om::Schema& schema);

} // namespace vkcim
