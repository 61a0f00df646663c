#pragma once

#include "host/ChassisType.h"
#include "vk/Root.h"

#include <string>
#include <vector>

namespace VK::Host {

/// A text that the host tells and the file that it stands in, or why there is none.
struct Fact {
    std::string text;    ///< empty when the host does not tell it
    std::string source;  ///< the file; for a text that is no use, where that stands
    int error = 0;       ///< without text: ENOENT the host has no such thing, EACCES we may not see it
    std::string useless; ///< without text: a placeholder that stands in its place

    explicit operator bool() const { return !text.empty(); }
};

/// One chassis; states already are node statuses.
struct ChassisFacts {
    Fact manufacturer;
    Fact version;
    Fact serial;
    Fact sku;
    ChassisType type = 0; ///< 0 when nothing tells it
    unsigned int status = 0;
};

/// What of a host does not change while it runs.
struct HardwareFacts {
    int tablesError = 0;               ///< why the SMBIOS tables could not be opened
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

/// Reads the facts of the host below `root`, each from the first source that tells it: /etc/machine-info, the
/// SMBIOS tables, the kernel's reading of them, the device tree, s390's system information, Xen.
HardwareFacts readHardware(const Root& root);

} // namespace VK::Host
