#pragma once

#include "vk/Root.h"

#include <optional>
#include <string>

namespace check {

// What this process finds and may do below a root. Files are looked for as the host sees them.

/// Why a file cannot be read; nothing where it can.
std::optional<std::string> problemOf(const VK::Root& root, const std::string& path);

/// Whether a file holds nothing but blanks, line ends and NULs, or cannot be read.
bool isEmpty(const VK::Root& root, const std::string& path);

bool isProgram(const VK::Root& root, const std::string& path);

/// Where PATH finds a command.
std::optional<std::string> findCommand(const VK::Root& root, const std::string& name);

/// Whether files can be made in a directory, which may have to be made first.
bool mayWriteIn(const VK::Root& root, std::string directory);

/// Whether this process has CAP_SYS_TIME.
bool maySetClock();

} // namespace check
