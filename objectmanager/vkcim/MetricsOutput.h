#pragma once

#include "objectmanager/vkcim/Facts.h"

namespace vkcim {

/// The facts as metrics, in a text that is both OpenMetrics and the older format of Prometheus: node_exporter's
/// textfile collector reads the latter alone. It has no type for state sets and information, so they are gauges. Only
/// of the first computer. Serial numbers are labels where they are asked for.
std::string metricsText(const Facts& facts, const om::Schema& schema, bool withSerials);

/// What a note says is missing: `UUID` of `no UUID: …`, or the file that has a fault. Nothing for the note on the
/// time service, and for a missing command: it serves a class that is no part of the facts, and most hosts have none.
std::optional<std::string> missingSource(const std::string& note);

} // namespace vkcim
