#pragma once

#include "vk/Instrumentation.h"
#include "vk/Moniker.h"

#include <string>

namespace VK::BaseServerProvider {

/// The two ends of the association between a computer system (key "Name") and its chassis (key "Tag", found by
/// "SystemName"). Each operation replaces the moniker of one end with that of the other; where it throws, the moniker
/// stays.
class ComputerSystemPackage {
public:
    ComputerSystemPackage();
    ~ComputerSystemPackage() noexcept(false);
    ComputerSystemPackage(const ComputerSystemPackage&) = delete;
    ComputerSystemPackage& operator=(const ComputerSystemPackage&) = delete;

    /// From a chassis to its computer. Throws FrameworkException without "Tag"; InstrumentationException when a chassis
    /// met on the way has no serial number, and when there is no such chassis or its computer has no name.
    void getComputerSystemMoniker(Moniker& monikerPackage);

    /// From a computer to its chassis: "SystemName" is the computer node's path. Throws FrameworkException without
    /// "Name", InstrumentationException when a computer has no name or none is found.
    void getPhysicalPackageMoniker(Moniker& monikerComputer);

    /// On purpose the UUID of the first computer, whichever computer the association concerns.
    bool getPlatformGUID(std::string& guid);

private:
    Instrumentation instrumentation;
};

} // namespace VK::BaseServerProvider
