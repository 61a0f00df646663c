#pragma once

#include <stdexcept>
#include <string>

namespace mof {

/// One thing wrong with a text, with its place: FILE:LINE: TEXT.
class MofError : public std::runtime_error {
public:
    MofError(const std::string& file, std::size_t line, const std::string& text)
        : std::runtime_error(file + ':' + std::to_string(line) + ": " + text) {}
};

} // namespace mof
