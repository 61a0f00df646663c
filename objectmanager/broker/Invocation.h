#pragma once

#include "objectmanager/broker/Context.h"
#include "objectmanager/broker/ObjectManager.h"

#include <chrono>
#include <vector>

namespace om {

class Broker;

/// Calls the provider's function for a request, with objects made for this call alone, and collects its answer.
/// `entries` make the context. `elapsed`, where given, receives the time spent in the provider's function. Throws
/// LoadError when the interface cannot be made.
Answer invoke(Broker& broker, const Request& request, std::vector<ContextEntry> entries,
              std::chrono::nanoseconds* elapsed = nullptr);

} // namespace om
