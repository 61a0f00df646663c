#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <cstddef>
#include <random>
#include <string>
#include <vector>

namespace load {

/// One kind of request, and the answer that it must get every time.
struct Kind {
    om::Request request;
    std::string name;   ///< for people
    std::string answer; ///< as JSON, without what differs from time to time
    bool slow;          ///< runs commands or writes the host's file
};

/// Makes the process's host a simulated one with two computers, three chassis and commands of its own, and sends the
/// log to `sink` with every level. Before the provider is loaded.
void makeHost(const std::string& sink);

/// A request's answer as JSON. The time in "TimeData" differs from call to call: its type and length stay.
std::string ask(om::ObjectManager& manager, const om::Request& request);

/// Requests of every operation and class, each asked once, one after the other, for its answer. Every answer is the
/// same however often and in whichever order the requests are asked.
std::vector<Kind> allKinds(om::ObjectManager& manager);

/// Picks among kinds of request, the same in every run with the same seed; about one in fifty is slow.
class Picker {
public:
    Picker(const std::vector<Kind>& kinds, unsigned seed);
    const Kind& next();

private:
    std::vector<const Kind*> quick;
    std::vector<const Kind*> slow;
    std::minstd_rand random;
};

} // namespace load
