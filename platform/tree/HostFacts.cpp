#include "vk/HostFacts.h"

#include "host/HardwareNotes.h"
#include "host/Hypervisor.h"
#include "host/ServiceNotes.h"
#include "tree/CurrentHost.h"
#include "tree/Cursor.h"
#include "vk/HostNotes.h"
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

std::string hostProblem() {
    Tree::SimulatedHost* const host = Tree::simulatedHost();
    if (host == nullptr) return Tree::problemOf(Root::host());
    const std::string problem = host->state()->problem;
    return problem.empty() ? std::string() : HostSource::current().location + ": " + problem;
}

std::vector<std::string> missingFacts() {
    if (const std::string problem = hostProblem(); !problem.empty()) return {problem};
    if (Tree::simulatedHost() != nullptr) return {};
    return Host::notesOn(Tree::realHost().reading()->facts);
}

/// A property of the computer; nothing where it does not say.
template <class Value>
std::optional<Value> ofComputer(unsigned int property) {
    Tree::Cursor computer;
    computer.selectType(NodeLexicon::ComputerSystemNode);
    Value value{};
    return computer.read(property, value) ? std::optional(value) : std::nullopt;
}

std::string hostTime() {
    return ofComputer<std::string>(NodeLexicon::SystemTimeProperty).value_or("");
}

std::string timeServiceNote() {
    Host::TimeFacts facts;
    facts.time = hostTime();
    facts.automaticDst = ofComputer<unsigned int>(NodeLexicon::AutomaticDSTAdjustmentProperty);
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

void vkHostProblem(VkHostNote take, void* context) {
    if (const std::string problem = VK::hostProblem(); !problem.empty()) take(context, problem.c_str());
}

void vkHostSource(VkHostNote take, void* context) {
    const VK::HostSource& source = VK::HostSource::current();
    if (source.kind == VK::HostSource::Live) return;
    const char* what = source.kind == VK::HostSource::Snapshot ? "the snapshot in " : "the simulated host in ";
    take(context, (what + source.location).c_str());
}

void vkHostTime(VkHostNote take, void* context) {
    if (const std::string time = VK::hostTime(); !time.empty()) take(context, time.c_str());
}

void vkHostOffset(VkHostNote take, void* context) {
    const std::optional<unsigned int> minutes = VK::ofComputer<unsigned int>(VK::NodeLexicon::GmtOffsetProperty);
    if (minutes) take(context, std::to_string(static_cast<int>(*minutes)).c_str()); // two's complement
}
