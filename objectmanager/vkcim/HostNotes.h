#pragma once

#include <string>
#include <vector>

namespace vkcim {

/// What the host could not tell and why, one line each, from the instrumentation library that the loaded provider
/// uses; empty for another provider than our own, and when that library does not tell.
std::vector<std::string> hostNotes(const std::string& provider);

} // namespace vkcim
