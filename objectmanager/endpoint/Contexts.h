#pragma once

#include "objectmanager/cimxml/Writer.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

namespace endpoint {

/// An enumeration that a client pulls: what it has not got yet, and how that is written.
struct Enumeration {
    using Write = std::function<void(cimxml::Writer&, const om::Result&)>;

    std::string nameSpace;
    std::string user;
    bool paths = false; ///< or instances
    std::vector<om::Result> elements;
    std::size_t next = 0;
    Write write;
    std::chrono::seconds timeout{0};
};

/// The open enumerations. Their number, in all and of one user, and the memory that they take are bounded; one that is
/// not pulled in time goes. Safe for threads.
class Contexts {
public:
    using Clock = std::chrono::steady_clock;
    static constexpr std::size_t mostContexts = 64;
    static constexpr std::size_t mostOfAUser = 16;
    static constexpr std::size_t mostBytes = 64U << 20U;

    /// Keeps an enumeration and returns its name, which nobody can guess. Throws CimError SERVER_LIMITS_EXCEEDED.
    std::string keep(Enumeration enumeration, Clock::time_point now = Clock::now());
    /// Takes an enumeration out, so that no second pull sees it meanwhile; nothing for one that is unknown, or that
    /// timed out.
    std::optional<Enumeration> take(const std::string& name, Clock::time_point now = Clock::now());
    /// Puts an enumeration back under its name, and starts its time anew.
    void putBack(const std::string& name, Enumeration enumeration, Clock::time_point now = Clock::now());

private:
    struct Kept {
        Enumeration enumeration;
        std::size_t bytes;
        Clock::time_point deadline;
    };

    void dropOld(Clock::time_point now);
    void store(const std::string& name, Enumeration enumeration, std::size_t bytes, Clock::time_point now);

    std::mutex mutex;
    std::map<std::string, Kept> kept;
    std::size_t held = 0; ///< bytes
};

} // namespace endpoint
