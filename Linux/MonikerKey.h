#pragma once

#include "vk/Moniker.h"

#include <string>

namespace VK::BaseServerProvider {

/// The value of the first key of exactly this name; throws FrameworkException
/// "Could not find '<name>' Key in Moniker" when there is none.
std::string requiredKey(Moniker& moniker, const char* name);

/// Replaces a moniker with one of a single key.
void replaceMoniker(Moniker& moniker, const char* name, const std::string& value);

} // namespace VK::BaseServerProvider
