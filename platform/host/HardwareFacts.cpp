#include "host/HardwareFacts.h"

#include "common/Text.h"
#include "host/HardwareSources.h"
#include "vk/Architecture.h"

#include <algorithm>
#include <cerrno>

namespace VK::Host {

namespace {

/// The node status of a chassis' state as SMBIOS numbers it.
unsigned int statusOfState(unsigned int state) {
    switch (state) {
    case 3:
        return 1; // safe
    case 4:
        return 21; // warning
    case 5:
        return 23; // critical
    case 6:
        return 26; // non-recoverable
    default:
        return 0;
    }
}

ChassisFacts fromTable(const SmbiosChassis& chassis) {
    ChassisFacts facts;
    facts.manufacturer = Tables::chassis(chassis.manufacturer);
    facts.version = Tables::chassis(chassis.version, FirmwareText::Model);
    facts.serial = Tables::chassis(chassis.serial);
    facts.sku = Tables::chassis(chassis.sku, FirmwareText::ChassisSku);
    facts.type = chassis.type;
    for (const unsigned int state : {chassis.bootUpState, chassis.powerSupplyState, chassis.thermalState})
        facts.status = std::max(facts.status, statusOfState(state)); // the worse, the larger
    return facts;
}

ChassisType typeFromText(const std::string& text) {
    const bool number = !text.empty() && text.size() < 4 && text.find_first_not_of("0123456789") == std::string::npos;
    return number ? static_cast<ChassisType>(std::stoul(text)) & 0x7F : 0;
}

/// Where the tables have none: what the kernel, the device tree or s390 say of the one chassis.
std::vector<ChassisFacts> withoutTables(const Root& root, const Sysinfo& sysinfo) {
    ChassisFacts facts;
    facts.manufacturer = firstOf({fromSysfs(root, "chassis_vendor"), sysinfo["Manufacturer"]});
    facts.version = fromSysfs(root, "chassis_version", FirmwareText::Model);
    facts.serial = fromSysfs(root, "chassis_serial");
    facts.type = typeFromText(textOfSysfs(root, "chassis_type"));
    if (facts.type == 0) facts.type = chassisTypeFromWord(fromDeviceTree(root, "chassis-type").text);
    const bool hasFacts = facts.manufacturer || facts.version || facts.serial || facts.type != 0 ||
                          fromDeviceTree(root, "model", FirmwareText::Model) || fromDeviceTree(root, "serial-number") ||
                          sysinfo.model() || sysinfo["Sequence Code"];
    return hasFacts ? std::vector<ChassisFacts>{facts} : std::vector<ChassisFacts>();
}

/// The tables' own word that there is no chassis holds only where they are whole.
void readChassis(HardwareFacts& facts, const Root& root, const Tables& tables, const Sysinfo& sysinfo) {
    for (const SmbiosChassis& chassis : tables.read().chassis) facts.chassis.push_back(fromTable(chassis));
    facts.noChassis = tables.withoutStructure();
    const bool whole = tables && tables.read().breakOff.empty();
    if (facts.chassis.empty() && !whole) facts.chassis = withoutTables(root, sysinfo);
}

/// Lenovo's product is a machine type (20HRCTO1WW); what people call the model stands in the version.
bool isLenovosModel(const Fact& manufacturer, const Fact& version) {
    if (lowerCase(manufacturer.text) != "lenovo") return false;
    const std::string text = lowerCase(version.text);
    const auto begins = [&text](const char* range) { return text.rfind(range, 0) == 0; };
    return begins("thinkpad ") || begins("thinkcentre ") || begins("thinkstation ");
}

/// Boards that are sold without a system are all that firmware knows where its buyer filled in nothing.
void takeBaseBoard(HardwareFacts& facts, const Root& root, const Tables& tables) {
    const Fact product = firstOf({tables.baseBoard(&SmbiosBaseBoard::product, FirmwareText::Model),
                                  fromSysfs(root, "board_name", FirmwareText::Model)});
    const Fact manufacturer = firstOf({tables.baseBoard(&SmbiosBaseBoard::manufacturer),
                                       fromSysfs(root, "board_vendor"), facts.firmwareManufacturer});
    if (!product) return;
    facts.firmwareModel = product;
    facts.firmwareManufacturer = manufacturer;
}

/// Manufacturer and model as the firmware has them.
void readNames(HardwareFacts& facts, const Root& root, const Tables& tables, const Sysinfo& sysinfo) {
    facts.firmwareManufacturer =
        firstOf({tables.system(&SmbiosSystem::manufacturer), fromSysfs(root, "sys_vendor"), sysinfo["Manufacturer"]});
    facts.firmwareModel = firstOf({tables.system(&SmbiosSystem::product, FirmwareText::Model),
                                   fromSysfs(root, "product_name", FirmwareText::Model),
                                   fromDeviceTree(root, "model", FirmwareText::Model), sysinfo.model()});
    const Fact version = firstOf({tables.system(&SmbiosSystem::version, FirmwareText::Model),
                                  fromSysfs(root, "product_version", FirmwareText::Model)});
    if (isLenovosModel(facts.firmwareManufacturer, version)) facts.firmwareModel = version;
    if (!facts.firmwareManufacturer && !facts.firmwareModel) takeBaseBoard(facts, root, tables);
}

} // namespace

HardwareFacts readHardware(const Root& root) {
    HardwareFacts facts;
    const MachineInfo info(root);
    const Tables tables(root);
    const Sysinfo sysinfo(root);
    facts.noTables = tables.whyNone();
    facts.problems = tables.problems();

    readNames(facts, root, tables, sysinfo);
    facts.manufacturer = firstOf({info["HARDWARE_VENDOR"], facts.firmwareManufacturer});
    facts.model = firstOf({info["HARDWARE_MODEL"], facts.firmwareModel});
    readChassis(facts, root, tables, sysinfo);
    facts.serial = firstOf({tables.system(&SmbiosSystem::serial), fromSysfs(root, "product_serial"),
                            fromDeviceTree(root, "serial-number"), sysinfo["Sequence Code"],
                            facts.chassis.empty() ? facts.noChassis : facts.chassis.front().serial});
    facts.sku = firstOf({tables.system(&SmbiosSystem::sku), fromSysfs(root, "product_sku")});
    facts.uuid = firstOf({asUuid(tables.system(&SmbiosSystem::uuid)), asUuid(fromSysfs(root, "product_uuid")),
                          asUuid(fromDeviceTree(root, "vm,uuid")), asUuid(fromXen(root))});
    facts.ownerContact = info["PRIMARY_OWNER_CONTACT"];
    facts.ownerName = info["PRIMARY_OWNER_NAME"];
    facts.architecture = architectureOf(root);

    const ChassisType written = chassisTypeFromWord(info["CHASSIS"].text);
    if (written != 0 && !facts.chassis.empty()) facts.chassis.front().type = written;
    return facts;
}

} // namespace VK::Host
