#pragma once

#include "support/Requests.h"

#include <nlohmann/json.hpp>

#include <functional>
#include <set>
#include <string>
#include <vector>

/// Requests whose calls to the object manager fail.
namespace test {

struct FaultCase {
    std::string name;
    om::Request request;
};

/// Makes the process's host one of two computers, one with two chassis; the first is named like this host, so that it
/// has the time service.
void simulateHostForFaults();
/// That host's file, parsed.
const nlohmann::json& untouchedHost();
/// As many chassis as the computer has that has the most.
constexpr std::size_t mostChassis = 2;

/// All that comes of a request.
struct Outcome {
    om::Answer answer;
    std::vector<std::string> lines;    ///< those logged, without their places and each once: the log channel's
    nlohmann::json host;               ///< the simulated host's file as it stands then
    std::vector<std::string> commands; ///< those asked for
};

/// Runs the request on that host, whatever an earlier one has changed.
Outcome runOnce(const om::Request& request);

/// The lines of a run that the one without a fault does not write.
std::vector<std::string> added(const std::vector<std::string>& lines, const std::vector<std::string>& whole);
/// Whether it is the line about an exception that ended an operation.
bool tellsException(const std::string& line);

bool isOneOf(const std::string& kind, const std::set<std::string>& kinds);

/// How an answer with a fault differs from the one without.
struct Loss {
    std::size_t elements = 0;
    std::size_t besideOthers = 0; ///< those of them whose class others of the answer have
    std::size_t properties = 0;
};

/// Every element must be one of the whole answer's, its path exactly so and its properties as far as they are there.
Loss compare(const om::Answer& part, const om::Answer& whole);

/// The faults that happened.
struct Tally {
    std::size_t runs = 0;
    std::set<std::string> kinds;
};

/// One run with a fault that happened. Without its status it answers as if nothing had failed.
using Check = std::function<void(const std::string& kind, bool unstated, const Outcome& outcome)>;

/// Runs the request with one call after the other failing, of every kind, with and without its status.
void failEachCall(const FaultCase& each, Tally& tally, const Check& check);
/// Runs the request with every call of a kind failing, for each kind that has happened so far.
void failAllCalls(const FaultCase& each, Tally& tally, const Check& check);

} // namespace test
