#pragma once

#include <string>

namespace vkcim {

/// The provider library that belongs to a `vkcim` in `directory`: the one in `directory`/../lib or, installed, in the
/// library directory beside it. The first of these when neither is there.
std::string defaultLibrary(const std::string& directory);

/// A library given by name, as dlopen wants it: without a slash dlopen would look everywhere but in the working
/// directory, where a file of that name goes first.
std::string libraryPath(const std::string& name);

/// The directory of the running program; empty when it cannot be found out.
std::string programDirectory();

} // namespace vkcim
