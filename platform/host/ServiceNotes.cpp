#include "host/ServiceNotes.h"

#include "common/Text.h"

#include <algorithm>
#include <cctype>
#include <unistd.h>

namespace VK::Host {

namespace {

bool isProcess(const std::string& name) {
    return !name.empty() && std::all_of(name.begin(), name.end(), [](unsigned char c) { return std::isdigit(c) != 0; });
}

} // namespace

std::string timeNote(const TimeFacts& facts) {
    std::string note = "time service: ";
    if (!facts.time.empty()) note += "time " + facts.time + ", ";
    if (!facts.zone.empty()) note += "zone " + facts.zone + ", ";
    if (facts.automaticDst)
        note += std::string("automatic daylight saving ") + (*facts.automaticDst != 0 ? "on" : "off") + ", ";
    // By its name, as the time service looks for it: chronyd and systemd-timesyncd may run all the same.
    return note + "NTP daemon ntpd " + (facts.ntpDaemonRuns ? "running" : "not running");
}

bool isNtpDaemonRunning(const Root& root) {
    const Root::Names processes = root.list("/proc");
    return std::any_of(processes.names.begin(), processes.names.end(), [&](const std::string& name) {
        return isProcess(name) &&
               lowerCase(root.read("/proc/" + name + "/cmdline").text).find("ntpd") != std::string::npos;
    });
}

std::string commandDirectory(const std::string& rootDirectory, bool isKvm) {
    return isKvm ? "/usr/sbin/" : rootDirectory.substr(0, rootDirectory.find("platform")) + "vcm/bin/";
}

std::string commandNote(const std::string& directory) {
    const std::string command = directory + "cimconfig";
    if (access(command.c_str(), X_OK) == 0) return {};
    return "no " + command + ": the delivery settings of the CIM server read as 0, which then means nothing";
}

} // namespace VK::Host
