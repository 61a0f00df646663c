#pragma once

#include "instrumentation/RealHost.h"
#include "instrumentation/SimulatedHost.h"

namespace VK {
#pragma GCC visibility push(hidden)
namespace Inside {

/// The process's simulated host; null when its host is not a simulated one.
SimulatedHost* simulatedHost();

/// The process's real host or snapshot. In a process with a simulated host this host, for what that leaves out.
RealHost& realHost();

} // namespace Inside
#pragma GCC visibility pop
} // namespace VK
