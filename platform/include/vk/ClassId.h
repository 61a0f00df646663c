#pragma once

namespace VK {

/// The product's classes by their numbers, which ProviderUtilities::getClassId returns.
enum class ClassId : unsigned short {
    ComputerSystem = 1,
    PhysicalPackage = 22,
    EnabledLogicalElementCapabilities = 23,
    ComputerSystemPackage = 24,
    ComputerCapabilities = 33,
    TimeService = 161,
    TimeServiceAffectsElement = 162,
    CIMServiceConfig = 185,
    Unknown = 255 ///< no class of the product's
};

} // namespace VK
