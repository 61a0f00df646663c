#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <string>
#include <vector>

namespace vkcim {

/// What did not take effect of a modification that the provider accepted, by what the instance was answered afterwards:
/// a line for each property that has another value than the wanted one, with the reason where there is one.
std::vector<std::string> notChanged(const om::Request& modification, const om::Answer& afterwards,
                                    const std::string& reason, const om::Schema& schema);

} // namespace vkcim
