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

    /// What `ask` returns, a shared pointer to T; asked once for each source while there is a look.
    template <class T, class Ask>
    static std::shared_ptr<const T> once(const void* source, Ask ask) {
        std::shared_ptr<const void>* const place = kept(source);
        if (place != nullptr && *place) return std::static_pointer_cast<const T>(*place);
        std::shared_ptr<const T> value = ask();
        if (place != nullptr) *place = value;
        return value;
    }
    /// The source is asked again: to be called after a change of our own.
    static void forget(const void* source) {
        if (std::shared_ptr<const void>* const place = kept(source); place != nullptr) place->reset();
    }

private:
    /// What the thread's look keeps of a source, null at first; no place at all where there is no look, or where it has
    /// too many sources.
    static std::shared_ptr<const void>* kept(const void* source);

    struct Place {
        const void* source = nullptr;
        std::shared_ptr<const void> value;
    };

    bool outermost = false;
    std::array<Place, 8> places;
};

} // namespace VK
