#pragma once

#include <string>
#include <string_view>

namespace VK::Host {

/// A chassis' type as SMBIOS numbers it: 1 other, 2 unknown, 3 desktop, … ; 0 and numbers above 36 mean nothing.
using ChassisType = unsigned int;
constexpr ChassisType unknownChassis = 2;
constexpr ChassisType lastChassisType = 36;

/// The type's name in SMBIOS's words, `Rack Mount Chassis`; `Unknown` for numbers that stand for nothing.
std::string chassisTypeName(ChassisType type);

/// The package type: 0 unknown, 1 chassis, 2 rack, 3 blade, 4 other.
unsigned int packageType(ChassisType type);

/// The type that a word of a device tree or of /etc/machine-info names (`server`, `laptop`); 0 for other words.
ChassisType chassisTypeFromWord(std::string_view word);

} // namespace VK::Host
