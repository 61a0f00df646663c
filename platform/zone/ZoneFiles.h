#pragma once

#include "zone/SavedFile.h"

#include <functional>
#include <string>

namespace VK::Zone {

/// One change of the files that make the time zone: /etc/localtime, /etc/timezone where there is one, and in
/// /var/lib/vk/instrumentation what they were before. Changes of several processes wait for each other.
class ZoneFiles {
public:
    /// Which of the zones replaced one after the other is kept.
    enum Keep { KeepFirst, KeepLatest };

    /// `isAsWanted` is asked once every other change is over: one of them may have made the host as this one is to.
    ZoneFiles(const Root& hostRoot, std::function<bool()> isAsWanted)
        : root(hostRoot), asWanted(std::move(isAsWanted)) {}

    /// Puts a zone of that offset for ever into force; false when that failed and nothing was changed.
    bool replaceByOffset(int minutes, Keep keep);
    /// Puts the zone that was kept into force again; false when that failed and nothing was changed.
    bool bringBack();

    /// Why it failed.
    const std::string& problem() const { return why; }
    /// What /etc/localtime was and is, for people; the latter empty when nothing had to be changed.
    const std::string& before() const { return was; }
    const std::string& after() const { return is; }

private:
    struct Session;

    bool fail(const std::string& what, int error = 0);
    bool begin(Session& session);
    bool put(const Session& session, const SavedZone& wanted);

    const Root& root;
    const std::function<bool()> asWanted;
    std::string why;
    std::string was;
    std::string is;
};

} // namespace VK::Zone
