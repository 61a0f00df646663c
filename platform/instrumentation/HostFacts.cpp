#include "vk/HostFacts.h"

#include "instrumentation/CurrentHost.h"
#include "instrumentation/HostNotes.h"
#include "instrumentation/Hypervisor.h"
#include "instrumentation/ServiceNotes.h"
#include "vk/HostSource.h"
#include "vk/Instrumentation.h"
#include "vk/Root.h"

namespace VK {

namespace {

bool startsWith(const std::string& text, const char* start) {
    return text.rfind(start, 0) == 0;
}

bool findOutKvm() {
    if (const std::optional<bool> given = productOverrides().kvm; given) return *given;
    if (HostSource::current().kind != HostSource::Snapshot && Inside::processorSaysKvm()) return true;
    const Inside::HardwareFacts& facts = Inside::realHost().hardware();
    return startsWith(facts.firmwareModel.text, "KVM") || startsWith(facts.firmwareManufacturer.text, "QEMU");
}

} // namespace

const ProductOverrides& productOverrides() {
    static const ProductOverrides overrides =
        Inside::simulatedHost() != nullptr ? Inside::simulatedHost()->state()->product : ProductOverrides();
    return overrides;
}

const std::string& hostUuid() {
    return Inside::realHost().hardware().uuid.text;
}

bool hostIsKVM() {
    static const bool kvm = findOutKvm();
    return kvm;
}

namespace {

std::vector<std::string> missingFacts() {
    if (Inside::SimulatedHost* host = Inside::simulatedHost(); host != nullptr) {
        const std::string problem = host->state()->problem;
        if (problem.empty()) return {};
        return {HostSource::current().location + ": " + problem};
    }
    Inside::RealHost& host = Inside::realHost();
    return host.problem().empty() ? Inside::notesOn(host.hardware()) : std::vector<std::string>{host.problem()};
}

std::string timeServiceNote() {
    Inside::TimeFacts facts;
    Instrumentation computer;
    computer.selectNode(NodeLexicon::ComputerSystemNode);
    computer.getProperty(NodeLexicon::SystemTimeProperty, facts.time);
    unsigned int automatic = 0;
    if (computer.getProperty(NodeLexicon::AutomaticDSTAdjustmentProperty, automatic)) facts.automaticDst = automatic;
    if (Inside::simulatedHost() == nullptr)
        facts.zone = Inside::zoneNameOf(Root::host().readLink("/etc/localtime").text);
    facts.ntpDaemonRuns = Inside::isNtpDaemonRunning(Root("/")); // commands run on this machine, whatever is described
    return Inside::timeNote(facts);
}

} // namespace

std::vector<std::string> hostNotes() {
    std::vector<std::string> notes = missingFacts();
    notes.push_back(timeServiceNote());
    const std::string root = productOverrides().rootDirectory.value_or(VK_ROOT_DIRECTORY);
    const std::string command = Inside::commandNote(Inside::commandFolder(root, hostIsKVM()));
    if (!command.empty()) notes.push_back(command);
    return notes;
}

} // namespace VK
