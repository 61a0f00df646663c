#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <string>
#include <vector>

/// What a request does, as one sequence: the provider's lines, its calls to the object manager, and its commands.
namespace test {

/// Runs the request on an empty log. Its events in order, as LogEvents.h has them; between the lines stand calls to the
/// broker and commands, as they are made below. Lines of the platform's libraries are left out.
std::vector<std::string> sequence(const om::Request& request);

/// The event of a call to the broker.
std::string brokerCall(const std::string& slot);

} // namespace test
