#pragma once

#include "host/ChassisType.h"
#include "host/Fact.h"
#include "vk/Root.h"

#include <string>
#include <vector>

namespace VK::Host {

/// One chassis; states already are node statuses.
struct ChassisFacts {
    Fact manufacturer;
    Fact version;
    Fact serial;
    Fact sku;
    ChassisType type = 0; ///< 0 when nothing says it
    unsigned int status = 0;
};

/// What of a host does not change while it runs.
struct HardwareFacts {
    Fact noTables;                     ///< why the SMBIOS tables cannot be used; its error is 0 when they can
    Fact noChassis;                    ///< why there is no chassis, where there is none
    std::vector<std::string> problems; ///< what is wrong with the tables, which file first

    Fact manufacturer; ///< of the system, as are the next four
    Fact model;
    Fact serial;
    Fact sku;
    Fact uuid;
    Fact firmwareManufacturer; ///< as above, without what an administrator wrote instead
    Fact firmwareModel;
    Fact ownerContact;
    Fact ownerName;
    std::string architecture; ///< see vk/Architecture.h
    std::vector<ChassisFacts> chassis;
};

/// Reads the facts of the host below `root`, each from the first source that has it: /etc/machine-info, the
/// SMBIOS tables, the kernel's reading of them, the device tree, s390's system information, Xen.
HardwareFacts readHardware(const Root& root);

} // namespace VK::Host
