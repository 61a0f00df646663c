#include "vk/HostFacts.h"

#include "host/HardwareNotes.h"
#include "host/Hypervisor.h"
#include "host/ServiceNotes.h"
#include "tree/CurrentHost.h"
#include "tree/Cursor.h"
#include "vk/HostSource.h"
#include "vk/Kept.h"
#include "vk/NodeLexicon.h"
#include "vk/Root.h"
#include "zone/ZoneInForce.h"

namespace VK {

namespace {

bool findOutKvm() {
    if (const std::optional<bool> given = productOverrides().kvm; given) return *given;
    return Host::isKvmGuest(Root::host(), Tree::realHost().reading()->facts);
}

} // namespace

ProductOverrides productOverrides() {
    static Kept<ProductOverrides> overrides;
    return *overrides.get(
        [] { return Tree::simulatedHost() != nullptr ? Tree::simulatedHost()->state()->product : ProductOverrides(); });
}

std::string hostUuid() {
    return Tree::realHost().reading()->facts.uuid.text;
}

bool hostIsKVM() {
    static Kept<bool> kvm;
    return *kvm.get(findOutKvm);
}

namespace {

std::vector<std::string> missingFacts() {
    if (Tree::SimulatedHost* host = Tree::simulatedHost(); host != nullptr) {
        const std::string problem = host->state()->problem;
        if (problem.empty()) return {};
        return {HostSource::current().location + ": " + problem};
    }
    const auto reading = Tree::realHost().reading();
    return reading->problem.empty() ? Host::notesOn(reading->facts) : std::vector<std::string>{reading->problem};
}

std::string timeServiceNote() {
    Host::TimeFacts facts;
    Tree::Cursor computer;
    computer.selectType(NodeLexicon::ComputerSystemNode);
    computer.read(NodeLexicon::SystemTimeProperty, facts.time);
    if (unsigned int automatic = 0; computer.read(NodeLexicon::AutomaticDSTAdjustmentProperty, automatic))
        facts.automaticDst = automatic;
    if (Tree::simulatedHost() == nullptr)
        facts.zone = Zone::zoneNameOf(Root::host().readLink(Zone::localTimeFile).text);
    facts.ntpDaemonRuns = Host::isNtpDaemonRunning(Root("/")); // commands run on this machine, also for a snapshot
    return Host::timeNote(facts);
}

} // namespace

std::vector<std::string> hostNotes() {
    std::vector<std::string> notes = missingFacts();
    notes.push_back(timeServiceNote());
    const std::string root = productOverrides().rootDirectory.value_or(VK_ROOT_DIRECTORY);
    const std::string command = Host::commandNote(Host::commandDirectory(root, hostIsKVM()));
    if (!command.empty()) notes.push_back(command);
    return notes;
}

} // namespace VK
