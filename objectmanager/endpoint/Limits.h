#pragma once

#include <chrono>
#include <cstddef>

namespace endpoint {

/// What a client may make use of.
struct Limits {
    std::size_t body = std::size_t{1} << 20U;
    std::size_t head = std::size_t{16} << 10U;
    std::size_t wholeAnswer = std::size_t{64} << 10U; ///< a longer one is written while it is sent
    std::size_t piece = std::size_t{16} << 10U;       ///< of it, at once
    unsigned connections = 64;                        ///< of all listeners together
    unsigned connectionsPerAddress = 8;
    std::chrono::milliseconds arrival = std::chrono::seconds(30); ///< of a whole request
    std::chrono::milliseconds answer = std::chrono::seconds(60);
    std::chrono::milliseconds taking = std::chrono::seconds(60);         ///< an answer that is ready
    std::chrono::milliseconds trust = std::chrono::seconds(60);          ///< in a password and rights, once checked
    std::chrono::milliseconds ending = std::chrono::seconds(30);         ///< of an operation while the server stops
    std::chrono::milliseconds endingOfHanging = std::chrono::seconds(1); ///< and of one that took too long already
    std::size_t workers = 8;
    std::size_t passwordChecks = 4; ///< at once
    std::size_t queue = 64;
};

} // namespace endpoint
