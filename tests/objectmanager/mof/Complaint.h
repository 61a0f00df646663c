#pragma once

#include "objectmanager/mof/MofError.h"

#include <string>

namespace mof {

/// What was thrown because of a text; empty where nothing was.
template <class Work>
std::string complaintOf(Work work) {
    try {
        work();
    } catch (const MofError& error) {
        return error.what();
    }
    return {};
}

} // namespace mof
