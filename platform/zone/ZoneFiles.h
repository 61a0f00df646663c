#pragma once

#include "zone/SavedFile.h"

#include <string>

namespace VK::Zone {

/// One change of the files that make the time zone: /etc/localtime, /etc/timezone where there is one, and the memory of
/// what they were before. Changes of several processes wait for each other. Each returns true when the host is as
/// asked once every other change is over, whether this one had to change anything or not; false when that failed, and
/// then zone and memory are as before.
class ZoneFiles {
public:
    /// The zone in force.
    struct State {
        std::string name; ///< what /etc/localtime is, for people
        int offset = 0;   ///< now, in minutes east of UTC
        bool daylightSaving = false;
    };

    explicit ZoneFiles(const Root& hostRoot) : root(hostRoot) {}

    /// Puts a zone that always has that offset into force, unless it is the offset now. What it replaces is
    /// remembered, unless something is already.
    bool putOffset(int minutes);
    /// The same at the standard offset of a zone with daylight saving, which is remembered instead of any other.
    bool dropDaylightSaving();
    /// Puts the zone that is remembered into force again, unless the one in force has daylight saving.
    bool bringBack();

    /// Why it failed.
    const std::string& problem() const { return reason; }
    /// Whether another zone is in force now, and from which to which it went.
    bool changed() const { return done; }
    const State& before() const { return old; }
    const State& after() const { return now; }

private:
    struct Session;

    bool fail(const std::string& what, int error = 0);
    bool begin(Session& session);
    bool replace(Session& session, int minutes, bool keepsOlder);
    bool put(const Session& session, const SavedZone& wanted, int from);
    void putName(const Session& session, const SavedFile& wanted, int from) const;

    const Root& root;
    std::string reason;
    bool done = false;
    State old;
    State now;
};

} // namespace VK::Zone
