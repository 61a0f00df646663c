#pragma once

#include "objectmanager/vkcim/Arguments.h"
#include "objectmanager/vkcim/Terminal.h"

#include <iosfwd>

namespace vkcim {

/// Where a run reads and writes.
struct Streams {
    std::istream& input;
    std::ostream& output;
    std::ostream& error;
    Look look = {};                 ///< of the output
    std::size_t messageColumns = 0; ///< at which messages are broken; 0 breaks none
};

/// Does what the arguments say and returns the exit status: 0 status OK, 1 another status (or the output cannot be
/// written), 2 a path or value that cannot be read, 3 a library that cannot be used, 4 status OK, but nothing was found
/// or changed, or the host cannot be read.
int run(const Arguments& arguments, const Streams& streams);

} // namespace vkcim
