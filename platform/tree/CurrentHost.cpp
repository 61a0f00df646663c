#include "tree/CurrentHost.h"

#include "vk/HostSource.h"

namespace VK::Tree {

SimulatedHost* simulatedHost() {
    static const std::unique_ptr<SimulatedHost> host(HostSource::current().kind == HostSource::Simulated
                                                         ? new SimulatedHost(HostSource::current().location)
                                                         : nullptr);
    return host.get();
}

RealHost& realHost() {
    static RealHost host(Root::host());
    return host;
}

NodeSource& NodeSource::current() {
    if (SimulatedHost* host = simulatedHost(); host != nullptr) return *host;
    return realHost();
}

} // namespace VK::Tree
