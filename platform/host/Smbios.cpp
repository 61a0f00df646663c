#include "host/Smbios.h"

#include "common/Text.h"

#include <set>

namespace VK::Host {

namespace {

constexpr unsigned int systemType = 1;
constexpr unsigned int baseBoardType = 2;
constexpr unsigned int chassisStructureType = 3;

/// Reads fields of one structure.
struct Fields {
    const SmbiosStructure& structure;
    std::size_t& badIndexes;

    std::string text(std::size_t offset) const { return cleanText(structure.stringAt(offset, badIndexes)); }
    unsigned int byte(std::size_t offset) const { return structure.byteAt(offset).value_or(0); }
};

SmbiosSystem readSystem(const Fields& fields, SmbiosVersion version) {
    SmbiosSystem system;
    system.manufacturer = fields.text(0x04);
    system.product = fields.text(0x05);
    system.version = fields.text(0x06);
    system.serial = fields.text(0x07);
    system.uuid = uuidFromBytes(fields.structure.bytesAt(0x08, 16).value_or(std::string_view()), version);
    system.sku = fields.text(0x19);
    return system;
}

SmbiosBaseBoard readBaseBoard(const Fields& fields) {
    return {fields.text(0x04), fields.text(0x05)};
}

SmbiosChassis readChassis(const Fields& fields) {
    SmbiosChassis chassis;
    chassis.manufacturer = fields.text(0x04);
    chassis.type = fields.byte(0x05) & 0x7F; // the first bit says whether there is a lock
    chassis.version = fields.text(0x06);
    chassis.serial = fields.text(0x07);
    chassis.bootUpState = fields.byte(0x09);
    chassis.powerSupplyState = fields.byte(0x0A);
    chassis.thermalState = fields.byte(0x0B);
    // The contained elements come before the last field: 0x13 holds their number, 0x14 the length of each.
    if (fields.structure.byteAt(0x14)) chassis.sku = fields.text(0x15 + fields.byte(0x13) * fields.byte(0x14));
    return chassis;
}

} // namespace

Smbios parseSmbios(std::string_view entryPoint, std::string_view table) {
    Smbios result;
    const SmbiosEntryPoint entry = parseSmbiosEntryPoint(entryPoint);
    result.entryPointProblem = entry.problem;
    if (!entry.problem.empty()) return result;
    result.version = entry.version;
    std::size_t badIndexes = 0;
    // Some firmware lists a chassis twice, under two handles. As two instances they would have the same path.
    std::set<SmbiosStructure::Contents> seen;
    SmbiosTable structures(table.substr(0, entry.tableLength));
    while (const auto structure = structures.next()) {
        const Fields fields{*structure, badIndexes};
        if (structure->type() == systemType && !result.system) result.system = readSystem(fields, entry.version);
        if (structure->type() == baseBoardType && !result.baseBoard) result.baseBoard = readBaseBoard(fields);
        if (structure->type() == chassisStructureType && seen.insert(structure->contents()).second)
            result.chassis.push_back(readChassis(fields));
    }
    // An empty file is no table of a machine that lacks everything: some firmware fails to hand it over.
    result.breakOff = table.empty() ? "table is empty" : structures.problem();
    if (!result.breakOff.empty()) result.problems.push_back(result.breakOff);
    if (badIndexes > 0)
        result.problems.push_back(std::to_string(badIndexes) + " string(s) that the table refers to are not there");
    return result;
}

} // namespace VK::Host
