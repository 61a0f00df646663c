#pragma once

namespace VK {

/// The identifier of a class, compared without regard to case; ProviderUtilities::CLASS_ID_UNKNOWN for null and for
/// classes that are not the product's own.
unsigned short findClassId(const char* className);

} // namespace VK
