#pragma once

#include <optional>
#include <string>
#include <vector>

// What the product's libraries share about the host, beside the operations of vk/Instrumentation.h.
namespace VK {

/// What a simulated host's file says of the product instead of the real host.
struct ProductOverrides {
    std::optional<std::string> architecture;
    std::optional<std::string> uid;
    std::optional<std::string> rootDirectory;
    std::optional<bool> kvm;
};

/// The overrides of the simulated host's file as it stood when first asked for; all absent when the process's host is
/// not a simulated one (vk/HostSource.h), or its file cannot be read.
ProductOverrides productOverrides();

/// The system's UUID as this machine's or the snapshot's files hold it; empty where they do not. What a simulated
/// host's file holds of its computer does not count.
std::string hostUuid();

/// Whether the host is a KVM virtual machine; found out once per process. A simulated host's file may say so. This
/// machine: CPUID says KVMKVMKVM (x86), or the firmware's system product name starts with KVM, or its system
/// manufacturer with QEMU. A snapshot: the firmware's names alone.
bool hostIsKVM();

/// For people: one line for each thing that the host does not say, and why: it lacks the source, or we may not see
/// it; then one on time, zone, daylight saving and whether the NTP daemon ntpd runs, and one where the CIM server's
/// configuration command is missing. Nothing is thrown but std::bad_alloc.
std::vector<std::string> hostNotes();

} // namespace VK
