#pragma once

#include <string>
#include <vector>

namespace test {

/// What this program handed to popen and system since it was last asked, in order, as `popen r: COMMAND` and
/// `system: COMMAND`. Only what is linked into the program itself is seen, not what its shared libraries do.
std::vector<std::string> takeShellCalls();

/// From now on commands that contain `text` cannot be started: popen answers null and system -1. After an empty text
/// all can.
void refuseToStart(const std::string& text);

/// From now on `replacement` stands for `text` in every command that is started. After an empty text none is replaced.
void startInstead(const std::string& text, const std::string& replacement);

} // namespace test
