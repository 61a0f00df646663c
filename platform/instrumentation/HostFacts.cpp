#include "vk/HostFacts.h"

#include "instrumentation/CurrentHost.h"
#include "instrumentation/HostNotes.h"
#include "instrumentation/Hypervisor.h"
#include "vk/HostSource.h"

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

bool hostIsKVM() {
    static const bool kvm = findOutKvm();
    return kvm;
}

std::vector<std::string> hostNotes() {
    std::vector<std::string> notes;
    if (Inside::SimulatedHost* host = Inside::simulatedHost(); host != nullptr) {
        if (const std::string problem = host->state()->problem; !problem.empty())
            notes.push_back(HostSource::current().location + ": " + problem);
        return notes;
    }
    Inside::RealHost& host = Inside::realHost();
    return host.problem().empty() ? Inside::notesOn(host.hardware()) : std::vector<std::string>{host.problem()};
}

} // namespace VK
