#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <optional>
#include <string>
#include <vector>

/// What a request does, as one sequence: the provider's lines, its calls to the object manager, and its commands.
namespace test {

/// Runs the request on an empty log. Its events in order, as LogEvents.h has them; between the lines stand calls to the
/// broker and commands, as they are made below. Lines of the platform's libraries are left out. `answer`, where given,
/// receives the answer.
std::vector<std::string> sequence(const om::Request& request, om::Answer* answer = nullptr);

/// The events of a call to the broker and of a command (`popen` or `system`).
std::string brokerCall(const std::string& slot);
std::string command(const std::string& function, const std::string& command);

/// Where an event stands for the first and for the last time; nothing when it does not.
std::optional<std::size_t> first(const std::vector<std::string>& events, const std::string& event);
std::optional<std::size_t> last(const std::vector<std::string>& events, const std::string& event);

} // namespace test
