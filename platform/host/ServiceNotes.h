#pragma once

#include "vk/Root.h"

#include <optional>
#include <string>

namespace VK::Host {

/// What stands behind the time service now; what is not known is empty.
struct TimeFacts {
    std::string time; ///< in CIM form
    std::string zone;
    std::optional<unsigned int> automaticDst;
    bool ntpDaemonRuns = false;
};

/// The facts in one line for people.
std::string timeNote(const TimeFacts& facts);

/// Whether `ntpd` stands in the command line of any process below `/proc` of that root, in any letter case: the
/// question that the time service asks of `ps`.
bool isNtpDaemonRunning(const Root& root);

/// The directory of the CIM server's commands for that root directory of the product, on a KVM guest or not.
std::string commandDirectory(const std::string& rootDirectory, bool isKvm);

/// That the directory lacks `cimconfig`, and what that means; empty when it is there.
std::string commandNote(const std::string& directory);

} // namespace VK::Host
