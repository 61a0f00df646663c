#pragma once

#include <functional>
#include <string>
#include <vector>

namespace test {

/// In a program that links NoCommands.cpp no command is ever started, whatever its libraries ask for. `popen` gives
/// what such commands would print on a host without an NTP daemon and with a configuration command that answers 30;
/// `system` says that all went well.

/// The commands asked for since it was last asked.
std::vector<std::string> takeCommands();

/// From now on `observer` is called for every command, as `popen` or `system` and what was asked. An empty one ends
/// that.
void tellCommands(std::function<void(const std::string& function, const std::string& command)> observer);

} // namespace test
