#pragma once

#include "host/Fact.h"
#include "host/Smbios.h"
#include "vk/Root.h"

#include <map>
#include <string>

namespace VK::Host {

inline const std::string tablesDirectory = "/sys/firmware/dmi/tables";
inline const std::string entryPointFile = tablesDirectory + "/smbios_entry_point";
inline const std::string tableFile = tablesDirectory + "/DMI";
inline const std::string sysinfoFile = "/proc/sysinfo";

/// What an administrator wrote into /etc/machine-info; nothing of it is a placeholder.
class MachineInfo {
public:
    explicit MachineInfo(const Root& root);
    Fact operator[](const char* key) const;

private:
    int error;
    std::map<std::string, std::string> values;
};

/// The SMBIOS tables, or why there are none.
class Tables {
public:
    explicit Tables(const Root& root);

    /// Whether they can be used.
    explicit operator bool() const { return none.error == 0; }
    /// Why they cannot: no such tables (ENOENT without a problem), not for us to see, or damaged.
    const Fact& whyNone() const { return none; }
    /// Why a structure that was not found is not there: the tables do not have it, or break off before it.
    Fact withoutStructure() const;

    Fact system(std::string SmbiosSystem::*text, FirmwareText kind = FirmwareText::Other) const;
    Fact baseBoard(std::string SmbiosBaseBoard::*text, FirmwareText kind = FirmwareText::Other) const;
    static Fact chassis(const std::string& text, FirmwareText kind = FirmwareText::Other);

    const Smbios& read() const { return smbios; }
    /// What is wrong with the tables, which file first.
    std::vector<std::string> problems() const;

private:
    Fact none;
    Smbios smbios;
};

/// The kernel's own reading of the tables: a file of /sys/class/dmi/id.
Fact fromSysfs(const Root& root, const char* name, FirmwareText kind = FirmwareText::Other);
/// The same, placeholder or not.
std::string textOfSysfs(const Root& root, const char* name);

Fact fromDeviceTree(const Root& root, const char* name, FirmwareText kind = FirmwareText::Other);

Fact fromXen(const Root& root);

/// s390's system information.
class Sysinfo {
public:
    explicit Sysinfo(const Root& root);
    Fact operator[](const char* key) const;
    /// Type and model.
    Fact model() const;

private:
    Fact value(const char* key, FirmwareText kind) const;

    Root::Contents contents;
};

/// The fact as a UUID; none where its text is no UUID, or one that many machines share.
Fact asUuid(Fact fact);

} // namespace VK::Host
