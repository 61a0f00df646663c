#pragma once

#include <cstdint>

namespace VK {

/// One look at the host, for a request: while it lives, its thread asks each file of a snapshot, and a simulated host's
/// file, once whether it has changed, and all its cursors see the host as it was then, or as the thread itself changed
/// it. Without one they ask each time. One within another is the same look. Of this host it changes nothing.
class HostLook {
public:
    HostLook();
    ~HostLook();
    HostLook(const HostLook&) = delete;
    HostLook& operator=(const HostLook&) = delete;

    /// The number of the thread's look, which no other has; 0 where there is none.
    static std::uint64_t number();

private:
    bool outermost = false;
};

} // namespace VK
