#pragma once

#include "vk/Instrumentation.h"

#include <string>

namespace VK::BaseServerProvider {

/// The name of the computer node that the cursor stands on; throws InstrumentationException with `failure` when it
/// cannot be read.
std::string requiredComputerName(const Instrumentation& node, const char* failure);

/// Selects the first computer node of exactly this name, or nothing. A computer without a name before it throws
/// InstrumentationException.
void selectComputer(Instrumentation& cursor, const std::string& name);

} // namespace VK::BaseServerProvider
