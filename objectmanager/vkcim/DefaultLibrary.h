#pragma once

#include <string>

namespace vkcim {

/// The provider library that belongs to a `vkcim` in `folder`: the one in `folder`/../lib or, installed, in the
/// library folder beside it. The first of these when neither is there.
std::string defaultLibrary(const std::string& folder);

/// The folder of the running program; empty when it cannot be told.
std::string programFolder();

} // namespace vkcim
