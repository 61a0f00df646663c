#pragma once

#include <cstddef>
#include <stdexcept>
#include <string>

namespace vkcim {

/// A text that cannot be read; the message says what is wrong and at which byte, counted from 1.
class ParseError : public std::runtime_error {
public:
    /// `offset` counts from 0.
    ParseError(std::size_t offset, const std::string& what)
        : std::runtime_error("position " + std::to_string(offset + 1) + ": " + what), position(offset + 1) {}

    const std::size_t position;
};

} // namespace vkcim
