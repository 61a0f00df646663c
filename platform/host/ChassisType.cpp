#include "host/ChassisType.h"

namespace VK::Host {

namespace {

constexpr const char* names[] = {
    nullptr,
    "Other",
    "Unknown",
    "Desktop",
    "Low Profile Desktop",
    "Pizza Box",
    "Mini Tower",
    "Tower",
    "Portable",
    "Laptop",
    "Notebook",
    "Hand Held",
    "Docking Station",
    "All in One",
    "Sub Notebook",
    "Space-saving",
    "Lunch Box",
    "Main Server Chassis",
    "Expansion Chassis",
    "SubChassis",
    "Bus Expansion Chassis",
    "Peripheral Chassis",
    "RAID Chassis",
    "Rack Mount Chassis",
    "Sealed-case PC",
    "Multi-system Chassis",
    "CompactPCI",
    "AdvancedTCA",
    "Blade",
    "Blade Enclosure",
    "Tablet",
    "Convertible",
    "Detachable",
    "IoT Gateway",
    "Embedded PC",
    "Mini PC",
    "Stick PC",
};

static_assert(sizeof names / sizeof *names == lastChassisType + 1);

bool isBetween(ChassisType type, ChassisType first, ChassisType last) {
    return first <= type && type <= last;
}

} // namespace

std::string chassisTypeName(ChassisType type) {
    return names[isBetween(type, 1, lastChassisType) ? type : unknownChassis];
}

unsigned int packageType(ChassisType type) {
    if (!isBetween(type, 1, lastChassisType) || type == unknownChassis) return 0;
    if (type == 23) return 2;
    if (type == 28) return 3;
    return isBetween(type, 3, 7) || isBetween(type, 17, 22) || isBetween(type, 24, 27) || type == 29 ? 1 : 4;
}

ChassisType chassisTypeFromWord(std::string_view word) {
    struct Known {
        std::string_view word;
        ChassisType type;
    };
    static constexpr Known descriptions[] = {
        {"desktop", 3}, {"laptop", 9},       {"handset", 11},  {"watch", 11}, {"server", 17},
        {"tablet", 30}, {"convertible", 31}, {"embedded", 34}, {"vm", 1},     {"container", 1},
    };
    for (const Known& known : descriptions)
        if (known.word == word) return known.type;
    return 0;
}

} // namespace VK::Host
