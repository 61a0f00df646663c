#include "provider/GoldenFile.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <iostream>

#include <unistd.h>

namespace test {
namespace {

using Lines = std::vector<std::string>;

Lines readLines(const std::string& file) {
    std::ifstream stream(file);
    Lines lines;
    for (std::string line; std::getline(stream, line);) lines.push_back(line);
    return lines;
}

/// What is to be taken out (-) and put in (+), by the longest list of lines that both have.
std::string difference(const Lines& old, const Lines& fresh) {
    std::vector<std::vector<std::size_t>> common(old.size() + 1, std::vector<std::size_t>(fresh.size() + 1));
    for (std::size_t i = old.size(); i-- > 0;)
        for (std::size_t j = fresh.size(); j-- > 0;)
            common[i][j] = old[i] == fresh[j] ? common[i + 1][j + 1] + 1 : std::max(common[i + 1][j], common[i][j + 1]);
    std::string text;
    std::size_t i = 0;
    std::size_t j = 0;
    while (i < old.size() || j < fresh.size()) {
        if (i < old.size() && j < fresh.size() && old[i] == fresh[j]) {
            ++i;
            ++j;
        } else if (j == fresh.size() || (i < old.size() && common[i + 1][j] >= common[i][j + 1])) {
            text += std::to_string(i + 1) + " - " + old[i] + "\n";
            ++i;
        } else {
            text += std::to_string(j + 1) + " + " + fresh[j] + "\n";
            ++j;
        }
    }
    return text;
}

bool mayWrite(const std::string& setting, const std::string& file) {
    if (setting == "yes") return true;
    if (isatty(STDIN_FILENO) == 0) return false;
    std::cout << "Write this into " << file << "? [y/N] " << std::flush;
    std::string answer;
    std::getline(std::cin, answer);
    return answer == "y" || answer == "Y";
}

} // namespace

std::string differenceFrom(const std::string& file, const Lines& lines) {
    const std::string differing = difference(readLines(file), lines);
    const char* const setting = std::getenv("VK_WRITE_TRACES");
    if (differing.empty() || setting == nullptr) return differing.empty() ? "" : file + "\n" + differing;
    std::cout << file << "\n" << differing;
    if (!mayWrite(setting, file)) return file + " was not written; without a terminal VK_WRITE_TRACES=yes agrees";
    std::ofstream stream(file);
    for (const std::string& line : lines) stream << line << '\n';
    return stream.flush() ? "" : file + " cannot be written";
}

} // namespace test
