#pragma once

#include "objectmanager/vkcim/Report.h"
#include "objectmanager/vkcim/Terminal.h"

#include <string>
#include <vector>

namespace vkcim {

/// The links as trees, one line each: what stands above everything first, each thing below it indented and with the
/// association's name. What hangs below a thing is drawn where it comes up first, and only there; so a circle of
/// links ends as well. Things and links keep the order in which they are given.
/// Where a line would be too long the association's name stands on the next one, and a path goes on behind its commas.
/// What would steer a
/// terminal is written out.
std::vector<std::string> drawLinks(const std::vector<Link>& links, const Look& look = {});

} // namespace vkcim
