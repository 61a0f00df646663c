#include "host/HardwareSources.h"

#include "common/Text.h"
#include "host/TextFiles.h"
#include "host/Uuid.h"

#include <cerrno>

namespace VK::Host {

namespace {

const std::string machineInfo = "/etc/machine-info";

Fact damaged(const std::string& file, const std::string& problem) {
    Fact fact = missing(file, EBADMSG);
    fact.problem = "is damaged: " + problem;
    return fact;
}

/// Only the directory's absence says that the firmware provides no tables.
Fact unreadable(const Root& root, const std::string& file, int error) {
    if (error == ENOENT && !root.exists(tablesDirectory)) return missing(tablesDirectory, ENOENT);
    Fact fact = missing(file, error);
    if (error == ENOENT) fact.problem = "is missing";
    return fact;
}

} // namespace

MachineInfo::MachineInfo(const Root& root) {
    const Root::Contents contents = root.read(machineInfo);
    error = contents.error;
    values = parseAssignments(contents.text);
}

Fact MachineInfo::operator[](const char* key) const {
    const auto found = values.find(key);
    if (found == values.end()) return missing(machineInfo, error != 0 ? error : ENOENT);
    Fact fact = missing(machineInfo, ENOENT);
    fact.text = cleanWrittenText(found->second);
    return fact;
}

Tables::Tables(const Root& root) {
    // Both are always read: a root that keeps a record must note both.
    const Root::Contents entryPoint = root.read(entryPointFile);
    const Root::Contents table = root.read(tableFile);
    if (!entryPoint) {
        none = unreadable(root, entryPointFile, entryPoint.error);
        return;
    }
    if (!table) {
        none = unreadable(root, tableFile, table.error);
        return;
    }
    smbios = parseSmbios(entryPoint.text, table.text);
    if (!smbios.entryPointProblem.empty()) none = damaged(entryPointFile, smbios.entryPointProblem);
}

Fact Tables::withoutStructure() const {
    if (none.error != 0) return none;
    return smbios.breakOff.empty() ? missing(tableFile, ENOENT) : damaged(tableFile, smbios.breakOff);
}

Fact Tables::system(std::string SmbiosSystem::*text, FirmwareText kind) const {
    return smbios.system ? factOf(tableFile, (*smbios.system).*text, kind) : withoutStructure();
}

Fact Tables::baseBoard(std::string SmbiosBaseBoard::*text, FirmwareText kind) const {
    return smbios.baseBoard ? factOf(tableFile, (*smbios.baseBoard).*text, kind) : withoutStructure();
}

Fact Tables::chassis(const std::string& text, FirmwareText kind) {
    return factOf(tableFile, text, kind);
}

std::vector<std::string> Tables::problems() const {
    if (!smbios.entryPointProblem.empty()) return {entryPointFile + ": " + smbios.entryPointProblem};
    std::vector<std::string> problems;
    for (const std::string& problem : smbios.problems) problems.push_back(tableFile + ": " + problem);
    return problems;
}

Fact fromSysfs(const Root& root, const char* name, FirmwareText kind) {
    const std::string file = std::string("/sys/class/dmi/id/") + name;
    const Root::Contents contents = root.read(file);
    return contents ? factOf(file, cleanText(firstLine(contents.text)), kind) : missing(file, contents.error);
}

std::string textOfSysfs(const Root& root, const char* name) {
    const Fact fact = fromSysfs(root, name);
    return fact ? fact.text : fact.placeholder;
}

Fact fromDeviceTree(const Root& root, const char* name, FirmwareText kind) {
    const std::string file = std::string("/proc/device-tree/") + name;
    const Root::Contents contents = root.read(file);
    return contents ? factOf(file, deviceTreeText(contents.text), kind) : missing(file, contents.error);
}

Fact fromXen(const Root& root) {
    const std::string file = "/sys/hypervisor/uuid";
    const Root::Contents contents = root.read(file);
    return contents ? factOf(file, cleanText(contents.text)) : missing(file, contents.error);
}

Sysinfo::Sysinfo(const Root& root) : contents(root.read(sysinfoFile)) {}

Fact Sysinfo::value(const char* key, FirmwareText kind) const {
    return contents ? factOf(sysinfoFile, sysinfoValue(contents.text, key), kind)
                    : missing(sysinfoFile, contents.error);
}

Fact Sysinfo::operator[](const char* key) const {
    return value(key, FirmwareText::Other);
}

Fact Sysinfo::model() const {
    Fact type = value("Type", FirmwareText::Model);
    if (const Fact model = value("Model", FirmwareText::Model); type && model) type.text += " " + model.text;
    return type;
}

Fact asUuid(Fact fact) {
    if (!fact) return fact;
    const std::string uuid = uuidFromText(fact.text);
    if (uuid.empty()) {
        Fact shared = missing(fact.source, ENOENT);
        shared.placeholder = fact.text;
        return shared;
    }
    fact.text = uuid;
    return fact;
}

} // namespace VK::Host
