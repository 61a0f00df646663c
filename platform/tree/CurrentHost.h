#pragma once

#include "tree/RealHost.h"
#include "tree/SimulatedHost.h"

namespace VK::Tree {

/// The process's simulated host; null when its host is not a simulated one.
SimulatedHost* simulatedHost();

/// The process's real host or snapshot. With a simulated host: this host, for what the simulated one leaves out.
RealHost& realHost();

} // namespace VK::Tree
