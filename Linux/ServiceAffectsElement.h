#pragma once

#include "vk/Moniker.h"

#include <string>

namespace VK::BaseServerProvider {

/// The two ends of the association between the time service and the computer system. Both are this host: each end's
/// moniker is made of the host name alone, whatever the other end's moniker says.
class TimeServiceAffectsElement {
public:
    /// Reads the host name; empty when it cannot be read.
    TimeServiceAffectsElement();
    ~TimeServiceAffectsElement() noexcept(false);
    TimeServiceAffectsElement(const TimeServiceAffectsElement&) = delete;
    TimeServiceAffectsElement& operator=(const TimeServiceAffectsElement&) = delete;

    /// "SystemName" is the host name.
    Moniker getTimeMoniker(Moniker& computerMoniker) const;
    /// "Name" is the host name.
    Moniker getComputerMoniker(Moniker& timeMoniker) const;

private:
    std::string hostName;
};

} // namespace VK::BaseServerProvider
