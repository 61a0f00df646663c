#pragma once

#include "objectmanager/broker/ObjectManager.h"
#include "objectmanager/vkcim/Arguments.h"

#include <istream>

namespace vkcim {

/// The request that the arguments stand for; not for `report`. A path given as `-` is the first line of `input`.
/// Throws std::runtime_error with a message for the user when a text cannot be read. What looks like a typing error and
/// may be asked all the same goes to `remarks`, a line each.
om::Request makeRequest(const Arguments& arguments, const om::Schema& schema, std::istream& input,
                        std::vector<std::string>* remarks = nullptr);

} // namespace vkcim
