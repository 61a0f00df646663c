#pragma once

#include <string>

namespace om {

/// The type name of a CMPI object of any kind, found by its function table, and a text of its content. Both throw
/// Failure INVALID_HANDLE for what is none of ours.
const char* typeNameOf(const void* object);
std::string describeObject(const void* object);

} // namespace om
