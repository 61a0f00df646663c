#pragma once

#include <string>
#include <vector>

/// What was logged since it was last asked, as `CHANNEL LEVEL CATEGORY TEXT`: the program's own logger records lines in
/// the logging library's place.
std::vector<std::string> takeLog();
