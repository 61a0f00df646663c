#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <sys/stat.h>

namespace VK::Tree {

/// A file's bytes and what it was when they were read.
struct TreeFileContents {
    std::string text;
    std::string problem; ///< why there is no text; empty when there is
    int error = 0;       ///< the errno value behind the problem, 0 where the file can be seen but is not to be used
    struct stat status {};
};

/// Reads a regular file of at most `limit` bytes; a larger one is refused unread. Never waits.
TreeFileContents readTreeFile(const std::string& file, std::size_t limit);

/// Makes the new text of a file from the present one, or says why not.
using TreeChange = std::function<std::string(const std::string& text, std::string& problem)>;

/// Reads a file, changes it and puts the new text in its place at one stroke: whoever reads it meanwhile finds the
/// old text or the new one. Writers wait for each other at the lock file `<file>.lock`, for ten seconds at most. A
/// link stays a link; the file keeps its mode and, where we may, its owner. Empty, or why it was not done.
std::string replaceTreeFile(const std::string& file, std::size_t limit, const TreeChange& change);

} // namespace VK::Tree
