#pragma once

#include <string>

namespace VK {

/// What log lines are made of lives as long as the library: threads may log while the process ends, when other static
/// objects are gone already. So at the process's end it is left to the system. It is freed only when the library is
/// unloaded: nobody uses it any more then.
class Lasting {
public:
    Lasting(const Lasting&) = delete;
    Lasting& operator=(const Lasting&) = delete;
    virtual ~Lasting() = default;

    /// Hands an object over; it was made with `new`, and goes when the library is unloaded. Waits for nobody.
    static void keep(Lasting* object) noexcept;

protected:
    Lasting() = default;

private:
    friend class LastingObjects;
    Lasting* next = nullptr;
};

/// A string of that kind.
std::string& lastingString(const char* text);

} // namespace VK
