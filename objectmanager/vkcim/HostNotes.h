#pragma once

#include <string>
#include <vector>

namespace vkcim {

/// What the host does not say and why, one line each, from the instrumentation library that the loaded provider
/// uses; empty for another provider than our own, and when that library lacks the function.
std::vector<std::string> hostNotes(const std::string& provider);

} // namespace vkcim
