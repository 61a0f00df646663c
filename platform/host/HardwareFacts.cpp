#include "host/HardwareFacts.h"

#include "common/Text.h"
#include "host/Placeholder.h"
#include "host/Smbios.h"
#include "host/TextFiles.h"
#include "logger/LogLine.h"
#include "vk/Architecture.h"

#include <cerrno>
#include <initializer_list>
#include <map>
#include <optional>

namespace VK::Host {

namespace {

const std::string ENTRY_POINT = "/sys/firmware/dmi/tables/smbios_entry_point";
const std::string TABLE = "/sys/firmware/dmi/tables/DMI";
const std::string MACHINE_INFO = "/etc/machine-info";
const std::string SYSINFO = "/proc/sysinfo";

using Test = bool (*)(std::string_view);

Fact missing(const std::string& source, int error) {
    Fact fact;
    fact.source = source;
    fact.error = error;
    return fact;
}

/// A text that stands in a file, unless it is useless there.
Fact told(const std::string& source, const std::string& text, Test isUseless = isPlaceholder) {
    if (text.empty() || isUseless(text)) {
        Fact fact = missing(source, ENOENT);
        fact.useless = text;
        return fact;
    }
    Fact fact;
    fact.source = source;
    fact.text = text;
    return fact;
}

/// The first that tells something; else the miss that tells most of the reason.
Fact firstOf(std::initializer_list<Fact> facts) {
    Fact best;
    for (const Fact& fact : facts) {
        if (fact) return fact;
        const bool better = best.source.empty() || (best.useless.empty() && !fact.useless.empty()) ||
                            (best.useless.empty() && best.error == ENOENT && fact.error != ENOENT);
        if (better) best = fact;
    }
    return best;
}

/// What an administrator wrote into /etc/machine-info.
class MachineInfo {
public:
    explicit MachineInfo(const Root& root) {
        const Root::Contents contents = root.read(MACHINE_INFO);
        error = contents.error;
        values = parseAssignments(contents.text);
    }
    Fact operator[](const char* key) const {
        const auto found = values.find(key);
        if (found == values.end()) return missing(MACHINE_INFO, error != 0 ? error : ENOENT);
        return told(MACHINE_INFO, cleanWrittenText(found->second), [](std::string_view) { return false; });
    }

private:
    int error = 0;
    std::map<std::string, std::string> values;
};

/// The SMBIOS tables, or why there are none.
struct Tables {
    int error = 0;
    Smbios smbios;

    explicit operator bool() const { return error == 0; }

    Fact system(std::string SmbiosSystem::*text, Test isUseless = isPlaceholder) const {
        if (error != 0) return missing(TABLE, error);
        return smbios.system ? told(TABLE, (*smbios.system).*text, isUseless) : missing(TABLE, ENOENT);
    }
};

Tables readTables(const Root& root, HardwareFacts& facts) {
    Tables tables;
    const Root::Contents entryPoint = root.read(ENTRY_POINT);
    const Root::Contents table = entryPoint ? root.read(TABLE) : entryPoint;
    tables.error = table.error;
    facts.tablesError = table.error;
    if (!tables) return tables;
    tables.smbios = parseSmbios(entryPoint.text, table.text);
    for (const std::string& problem : tables.smbios.problems) facts.problems.push_back(TABLE + ": " + problem);
    if (const std::string& problem = tables.smbios.entryPointProblem; !problem.empty()) {
        facts.problems.push_back(ENTRY_POINT + ": " + problem);
        tables.error = EBADMSG;
    }
    return tables;
}

Fact fromSysfs(const Root& root, const char* name, Test isUseless = isPlaceholder) {
    const std::string file = std::string("/sys/class/dmi/id/") + name;
    const Root::Contents contents = root.read(file);
    return contents ? told(file, cleanText(firstLine(contents.text)), isUseless) : missing(file, contents.error);
}

Fact fromDeviceTree(const Root& root, const char* name, Test isUseless = isPlaceholder) {
    const std::string file = std::string("/proc/device-tree/") + name;
    const Root::Contents contents = root.read(file);
    return contents ? told(file, deviceTreeText(contents.text), isUseless) : missing(file, contents.error);
}

/// s390's system information.
class Sysinfo {
public:
    explicit Sysinfo(const Root& root) : contents(root.read(SYSINFO)) {}
    Fact operator[](const char* key) const {
        return contents ? told(SYSINFO, sysinfoValue(contents.text, key)) : missing(SYSINFO, contents.error);
    }
    Fact model() const {
        Fact type = (*this)["Type"];
        if (const Fact model = (*this)["Model"]; type && model) type.text += " " + model.text;
        return type;
    }

private:
    Root::Contents contents;
};

/// A fact's text as a UUID.
Fact asUuid(Fact fact) {
    const std::string uuid = uuidFromText(fact.text);
    return fact ? told(fact.source, uuid.empty() ? fact.text : uuid,
                       [](std::string_view text) { return uuidFromText(text).empty(); })
                : fact;
}

Fact fromXen(const Root& root) {
    const std::string file = "/sys/hypervisor/uuid";
    const Root::Contents contents = root.read(file);
    return contents ? told(file, cleanText(contents.text)) : missing(file, contents.error);
}

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
    facts.manufacturer = told(TABLE, chassis.manufacturer);
    facts.version = told(TABLE, chassis.version);
    facts.serial = told(TABLE, chassis.serial, isPlaceholderSerial);
    facts.sku = told(TABLE, chassis.sku);
    facts.type = chassis.type;
    for (const unsigned int state : {chassis.bootUpState, chassis.powerSupplyState, chassis.thermalState})
        facts.status = std::max(facts.status, statusOfState(state)); // the worse, the larger
    return facts;
}

ChassisType typeFromText(const Fact& fact) {
    const std::string& text = fact.text;
    const bool number = !text.empty() && text.size() < 4 && text.find_first_not_of("0123456789") == std::string::npos;
    return number ? static_cast<ChassisType>(std::stoul(text)) & 0x7F : 0;
}

/// Of a host without tables: what the kernel, the device tree or s390 tell of its one chassis.
std::vector<ChassisFacts> withoutTables(const Root& root, const Sysinfo& sysinfo) {
    ChassisFacts facts;
    const auto anything = [](std::string_view) { return false; };
    const Fact treeType = fromDeviceTree(root, "chassis-type");
    facts.manufacturer = firstOf({fromSysfs(root, "chassis_vendor"), sysinfo["Manufacturer"]});
    facts.version = fromSysfs(root, "chassis_version");
    facts.serial = fromSysfs(root, "chassis_serial", isPlaceholderSerial);
    facts.type = typeFromText(fromSysfs(root, "chassis_type", anything));
    if (facts.type == 0) facts.type = chassisTypeFromWord(treeType.text);
    const bool told = facts.manufacturer || facts.version || facts.serial || facts.type != 0 ||
                      fromDeviceTree(root, "model") || fromDeviceTree(root, "serial-number") || sysinfo.model() ||
                      sysinfo["Sequence Code"];
    return told ? std::vector<ChassisFacts>{facts} : std::vector<ChassisFacts>();
}

} // namespace

HardwareFacts readHardware(const Root& root) {
    HardwareFacts facts;
    const MachineInfo info(root);
    const Tables tables = readTables(root, facts);
    const Sysinfo sysinfo(root);

    facts.firmwareManufacturer =
        firstOf({tables.system(&SmbiosSystem::manufacturer), fromSysfs(root, "sys_vendor"), sysinfo["Manufacturer"]});
    facts.manufacturer = firstOf({info["HARDWARE_VENDOR"], facts.firmwareManufacturer});
    facts.firmwareModel = firstOf({tables.system(&SmbiosSystem::product), fromSysfs(root, "product_name"),
                                   fromDeviceTree(root, "model"), sysinfo.model()});
    facts.model = firstOf({info["HARDWARE_MODEL"], facts.firmwareModel});
    facts.serial = firstOf({tables.system(&SmbiosSystem::serial, isPlaceholderSerial),
                            fromSysfs(root, "product_serial", isPlaceholderSerial),
                            fromDeviceTree(root, "serial-number", isPlaceholderSerial), sysinfo["Sequence Code"]});
    facts.sku = firstOf({tables.system(&SmbiosSystem::sku), fromSysfs(root, "product_sku")});
    facts.uuid = firstOf({asUuid(tables.system(&SmbiosSystem::uuid)), asUuid(fromSysfs(root, "product_uuid")),
                          asUuid(fromDeviceTree(root, "vm,uuid")), asUuid(fromXen(root))});
    facts.ownerContact = info["PRIMARY_OWNER_CONTACT"];
    facts.ownerName = info["PRIMARY_OWNER_NAME"];
    facts.architecture = architectureOf(root);

    if (tables) {
        for (const SmbiosChassis& chassis : tables.smbios.chassis) facts.chassis.push_back(fromTable(chassis));
    } else {
        facts.chassis = withoutTables(root, sysinfo);
    }
    const ChassisType written = chassisTypeFromWord(info["CHASSIS"].text);
    if (written != 0 && !facts.chassis.empty()) facts.chassis.front().type = written;
    return facts;
}

} // namespace VK::Host
