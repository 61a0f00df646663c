#pragma once

#include <cmpift.h>

namespace om {

/// The message slots of the factory table. They take the values for `$0` to `$9` as variable arguments, and so are
/// functions of exactly the slots' type.
CMPIString* getMessage(const CMPIBroker* broker, const char* messageId, const char* defaultText, CMPIStatus* rc,
                       CMPICount pairs, ...);
CMPIString* getMessage2(const CMPIBroker* broker, const char* messageId, CMPIMsgFileHandle file,
                        const char* defaultText, CMPIStatus* rc, CMPICount pairs, ...);

} // namespace om
