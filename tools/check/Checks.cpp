#include "tools/check/Checks.h"

#include "host/HardwareSources.h"
#include "host/Hypervisor.h"
#include "host/ServiceNotes.h"
#include "tools/check/Surroundings.h"
#include "zone/ZoneInForce.h"
#include "zone/ZoneMemory.h"

namespace check {

using VK::Root;

namespace {

using Problem = std::optional<std::string>;

std::string withProblem(const std::string& file, const Problem& problem) {
    return problem ? file + ": " + *problem : file;
}

Finding hardware(const Root& root) {
    Finding finding{Part::Reading, "hardware tables", true, VK::Host::tablesDirectory,
                    "VESKA_PhysicalPackage and the computer's UUID, model and serial number come from elsewhere, are "
                    "incomplete, or are missing"};
    for (const std::string& table : {VK::Host::entryPointFile, VK::Host::tableFile}) {
        const Problem problem = problemOf(root, table);
        if (!problem) continue;
        for (const std::string& other : {std::string("/proc/device-tree/model"), VK::Host::sysinfoFile}) {
            if (*problem != "not there" || isEmpty(root, other)) continue;
            finding.detail = other + ", in place of SMBIOS tables";
            return finding;
        }
        finding.found = false;
        finding.detail = withProblem(table, problem);
        return finding;
    }
    return finding;
}

Finding readable(const Root& root, Part part, const std::string& name, const std::string& file,
                 const std::string& without) {
    Problem problem = problemOf(root, file);
    if (!problem && isEmpty(root, file)) problem = "empty";
    return {part, name, !problem, withProblem(file, problem), without};
}

Finding timeZone(const Root& root) {
    Problem problem = problemOf(root, VK::Zone::localTimeFile);
    if (!problem && !root.read(VK::Zone::localTimeFile).text.starts_with("TZif")) problem = "no time zone file";
    return {Part::Reading, "time zone", !problem, withProblem(VK::Zone::localTimeFile, problem),
            "the host's zone counts as UTC"};
}

Finding command(const Root& root, const std::string& name, const std::string& without) {
    const std::optional<std::string> found = findCommand(root, name);
    return {Part::Setting, name, found.has_value(), found.value_or("not in PATH"), without};
}

Finding ntpService(const Root& root) {
    const std::string file = "/etc/init.d/ntp";
    const bool found = isProgram(root, file);
    return {Part::Setting, file, found, found ? file : file + " is not there or not executable",
            "ManageTime cannot stop and start a running NTP daemon, and fails"};
}

Finding cimconfig(const Root& root, Part part, const std::string& without) {
    const bool kvm = VK::Host::isKvmGuest(root, VK::Host::readHardware(root));
    const std::string file = VK::Host::commandDirectory(VK_ROOT_DIRECTORY, kvm) + "cimconfig";
    const bool found = isProgram(root, file);
    return {part, "cimconfig", found,
            file + (kvm ? " (a KVM guest's place)" : "") +
                (found ? "" : " is not there or not executable; see vk-provider-register(8)"),
            without};
}

Finding rightToSetClock() {
    const bool found = maySetClock();
    return {Part::Setting, "right to set the clock", found, found ? "CAP_SYS_TIME" : "CAP_SYS_TIME is missing",
            "ManageTime cannot set the time"};
}

/// What was there before is kept in the other directory, which the provider makes when it is needed.
Finding rightToChangeZone(const Root& root) {
    const std::string both = "/etc and " + VK::Zone::ZoneMemory::stateDirectory;
    const bool etc = mayWriteIn(root, "/etc");
    const bool memory = mayWriteIn(root, VK::Zone::ZoneMemory::stateDirectory);
    const std::string closed = etc == memory ? both : etc ? VK::Zone::ZoneMemory::stateDirectory : "/etc";
    return {Part::Setting, "right to change the zone", etc && memory,
            closed + (etc && memory ? " can" : " cannot") + " be written",
            "ManageTime cannot set the time, and AutomaticDSTAdjustment cannot be changed"};
}

} // namespace

std::vector<Finding> findings(const Root& root) {
    return {hardware(root),
            readable(root, Part::Reading, "machine id", "/etc/machine-id",
                     "the host's unique identifier is made of its UUID, or missing"),
            timeZone(root),
            cimconfig(root, Part::Reading, "VESKA_CIMServiceConfig shows 0 for both settings"),
            readable(root, Part::Setting, "time zones", VK::Zone::zoneDirectory + "Etc/GMT",
                     "an offset set by ManageTime becomes a file of its own, not a link to a zone that has a name"),
            command(root, "ps", "the NTP daemon always counts as not running"),
            command(root, "ntpd", "ManageTime sets the time and then fails, since the clock cannot be synchronised"),
            ntpService(root),
            cimconfig(root, Part::Setting, "SetCIMconfig fails"),
            rightToSetClock(),
            rightToChangeZone(root)};
}

} // namespace check
