#pragma once

#include "host/SmbiosTable.h"

#include <string>
#include <string_view>
#include <vector>

namespace VK::Host {

/// What the tables say of the system. Texts are clean, but may be placeholders; so may the UUID.
struct SmbiosSystem {
    std::string manufacturer;
    std::string product;
    std::string version;
    std::string serial;
    std::string sku;
    std::string uuid;
};

/// What the tables say of the base board.
struct SmbiosBaseBoard {
    std::string manufacturer;
    std::string product;
};

/// What the tables say of one chassis; states and types as numbered there, 0 where the structure does not reach.
struct SmbiosChassis {
    std::string manufacturer;
    std::string version;
    std::string serial;
    std::string sku;
    unsigned int type = 0; ///< without the lock bit
    unsigned int bootUpState = 0;
    unsigned int powerSupplyState = 0;
    unsigned int thermalState = 0;
};

struct Smbios {
    SmbiosVersion version;
    std::optional<SmbiosSystem> system;       ///< the first of them
    std::optional<SmbiosBaseBoard> baseBoard; ///< the first of them
    std::vector<SmbiosChassis> chassis;       ///< all of them, in order; one that repeats another only once
    std::string entryPointProblem;            ///< why nothing was read
    std::string breakOff;              ///< where and why the table cannot be read on; what stands before it was read
    std::vector<std::string> problems; ///< all that is wrong with the table, that included
};

/// Reads what the kernel shows as `smbios_entry_point` and `DMI`.
Smbios parseSmbios(std::string_view entryPoint, std::string_view table);

} // namespace VK::Host
