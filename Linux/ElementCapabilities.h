#pragma once

#include "vk/Instrumentation.h"
#include "vk/Moniker.h"

namespace VK::BaseServerProvider {

/// The two ends of the association between a computer system (key "Name") and its capabilities (key "InstanceID").
/// Each operation replaces the moniker of one end with that of the other; where it throws, the moniker stays.
class ElementCapabilities {
public:
    ElementCapabilities();
    ~ElementCapabilities() noexcept(false);
    ElementCapabilities(const ElementCapabilities&) = delete;
    ElementCapabilities& operator=(const ElementCapabilities&) = delete;

    /// From a computer to its capabilities. A name that no computer has gives an empty "InstanceID" and no error,
    /// on purpose. Throws FrameworkException without "Name", InstrumentationException when a computer has no name.
    void getCapabilitiesMoniker(Moniker& monikerComputer);

    /// From capabilities to their computer. Throws FrameworkException without "InstanceID",
    /// InstrumentationException when there is no such computer or it has no name.
    void getComputerMoniker(Moniker& monikerCapabilities);

private:
    Instrumentation instrumentation;
};

} // namespace VK::BaseServerProvider
