#pragma once

#include <string>
#include <vector>

namespace test {

/// Compares lines with those that a file holds: where they are the same the answer is empty, else it says what differs.
/// With VK_WRITE_TRACES in the environment the difference is printed and the file written, if somebody at the terminal
/// agrees or the variable says `yes`; the answer is empty then, too.
std::string differenceFrom(const std::string& file, const std::vector<std::string>& lines);

} // namespace test
