#pragma once

#include "fuzz/Choices.h"
#include "objectmanager/broker/ObjectManager.h"

namespace fuzz {

/// Any request: known and unknown classes and names, keys and arguments of any type, sometimes with a fault of the
/// object manager.
om::Request randomRequest(Choices& choices, const std::string& hostName);

} // namespace fuzz
