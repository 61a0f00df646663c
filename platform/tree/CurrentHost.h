#pragma once

#include "tree/RealHost.h"
#include "tree/SimulatedHost.h"

namespace VK::Tree {

/// The process's simulated host; null when its host is not a simulated one.
SimulatedHost* simulatedHost();

/// The process's real host or snapshot. In a process with a simulated host this host, for what that leaves out.
RealHost& realHost();

} // namespace VK::Tree
