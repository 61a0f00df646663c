#include "zone/ZoneFiles.h"

#include "common/AtomicFile.h"
#include "common/FileDescriptor.h"
#include "common/FileLock.h"
#include "logger/LogLine.h"
#include "zone/ZoneInForce.h"

#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <optional>
#include <sys/stat.h>
#include <unistd.h>

namespace VK::Zone {

namespace {

const std::string STATE_FOLDER = "/var/lib/vk/instrumentation";
const std::string KEPT_NAME = "replaced-zone";
const std::string KEPT = STATE_FOLDER + "/" + KEPT_NAME;
const std::string ZONES = "/usr/share/zoneinfo/";

/// Opens a folder, made with those above it where they are missing: a descriptor or a negative errno value.
int openFolder(const Root& root, const std::string& path) {
    const int fd = root.open(path, O_RDONLY | O_DIRECTORY);
    if (fd != -ENOENT || path == "/") return fd;
    const std::size_t slash = path.rfind('/');
    const int above = openFolder(root, slash == 0 ? "/" : path.substr(0, slash));
    const FileDescriptor parent(above);
    if (above < 0) return above;
    if (mkdirat(parent.get(), path.c_str() + slash + 1, 0755) != 0 && errno != EEXIST) return -errno;
    return root.open(path, O_RDONLY | O_DIRECTORY);
}

/// A zone file's last line, the rule; or how long it is.
std::string describeBytes(const std::string& bytes) {
    const std::size_t begin = bytes.size() < 2 ? std::string::npos : bytes.rfind('\n', bytes.size() - 2);
    if (begin == std::string::npos || bytes.back() != '\n' || bytes.size() - begin > 64)
        return "a file of " + std::to_string(bytes.size()) + " bytes";
    return bytes.substr(begin + 1, bytes.size() - begin - 2);
}

std::string describe(const SavedFile& localTime) {
    if (localTime.kind == SavedFile::Absent) return "nothing";
    if (localTime.kind == SavedFile::File) return describeBytes(localTime.content);
    const std::size_t zones = localTime.content.find("zoneinfo/");
    return zones == std::string::npos ? localTime.content : localTime.content.substr(zones + 9);
}

/// The zone folder's name of a zone that is that offset for ever. Its signs are those of POSIX: west is positive.
std::string nameOfOffset(const Root& root, int minutes) {
    if (minutes % 60 != 0) return {};
    std::string name = "Etc/GMT";
    if (minutes != 0) name += (minutes > 0 ? "-" : "+") + std::to_string(std::abs(minutes) / 60);
    const std::optional<TimeZone> zone = zoneOfFile(root, ZONES + name);
    const bool right = zone && zone->at(0).offset == minutes * 60 && !zone->hasDaylightSavingFrom(0);
    return right ? name : std::string();
}

/// What /etc/localtime and /etc/timezone are to be for a zone of that offset.
SavedZone zoneOfOffset(const Root& root, int minutes) {
    SavedZone zone;
    zone.zoneName.kind = SavedFile::File;
    if (const std::string name = nameOfOffset(root, minutes); !name.empty()) {
        zone.localTime = {SavedFile::Link, ".." + ZONES + name};
        zone.zoneName.content = name + "\n";
    } else {
        zone.localTime = {SavedFile::File, makeZoneFile(minutes)};
        zone.zoneName.content = describeBytes(zone.localTime.content) + "\n";
    }
    return zone;
}

} // namespace

/// What a change holds on to until it is done.
struct ZoneFiles::Session {
    FileDescriptor state;
    FileDescriptor etc;
    std::optional<FileLock> lock;
    SavedZone present;
};

bool ZoneFiles::fail(const std::string& what, int error) {
    why = what;
    if (error != 0) why += ": " + errorText(error);
    if (error == EACCES || error == EPERM) why += "; this takes root, or the privilege CAP_DAC_OVERRIDE";
    return false;
}

bool ZoneFiles::begin(Session& session) {
    const int state = openFolder(root, STATE_FOLDER);
    session.state = FileDescriptor(state);
    if (state < 0) return fail(STATE_FOLDER, -state);
    const int etc = root.open("/etc", O_RDONLY | O_DIRECTORY);
    session.etc = FileDescriptor(etc);
    if (etc < 0) return fail("/etc", -etc);
    session.lock.emplace(session.state.get(), "lock");
    if (const int error = session.lock->error(); error != 0) return fail(STATE_FOLDER + "/lock", error);
    if (const int error = lookAt(root, "/etc/localtime", session.present.localTime); error != 0)
        return fail("/etc/localtime", error);
    if (const int error = lookAt(root, "/etc/timezone", session.present.zoneName); error != 0)
        return fail("/etc/timezone", error);
    was = describe(session.present.localTime);
    return true;
}

bool ZoneFiles::put(const Session& session, const SavedZone& wanted) {
    if (const int error = putBack(session.etc.get(), "localtime", wanted.localTime); error != 0)
        return fail("/etc/localtime", error);
    is = describe(wanted.localTime);
    // The name is for people and old programs: the zone is in force without it.
    if (session.present.zoneName.kind != SavedFile::Absent && wanted.zoneName.kind != SavedFile::Absent)
        if (const int error = putBack(session.etc.get(), "timezone", wanted.zoneName); error != 0)
            logLine(FAILURE, "put", __LINE__, "/etc/timezone does not follow: " + errorText(error));
    return true;
}

bool ZoneFiles::replaceByOffset(int minutes, Keep keep) {
    Session session;
    if (!begin(session)) return false;
    if (asWanted()) return true;
    // Kept before the zone changes: at no time is there a change that cannot be taken back.
    const bool keepThis = keep == KeepLatest || !root.exists(KEPT);
    if (keepThis) {
        const FileOwner owner{0644, geteuid(), getegid()};
        const int error = replaceFile(session.state.get(), KEPT_NAME, writeSavedZone(session.present), owner);
        if (error != 0) return fail(KEPT, error);
    }
    if (put(session, zoneOfOffset(root, minutes))) return true;
    if (keepThis) unlinkat(session.state.get(), KEPT_NAME.c_str(), 0);
    return false;
}

bool ZoneFiles::bringBack() {
    if (!root.exists(KEPT)) return fail("no zone with daylight saving was replaced");
    Session session;
    if (!begin(session)) return false;
    if (asWanted()) return true;
    const Root::Contents bytes = root.read(KEPT, Root::DEFAULT_LIMIT * 3);
    if (!bytes) return fail(KEPT, bytes.error);
    const std::optional<SavedZone> kept = readSavedZone(bytes.text);
    if (!kept) return fail(KEPT + " is damaged");
    if (!put(session, *kept)) return false;
    unlinkat(session.state.get(), KEPT_NAME.c_str(), 0);
    return true;
}

} // namespace VK::Zone
