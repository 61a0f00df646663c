#pragma once

#include <array>
#include <memory>

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

    /// What the thread's look keeps of a source, null at first; no place at all where there is no look, or where it has
    /// too many sources.
    static std::shared_ptr<const void>* kept(const void* source);

private:
    struct Place {
        const void* source = nullptr;
        std::shared_ptr<const void> value;
    };

    bool outermost = false;
    std::array<Place, 8> places;
};

} // namespace VK
