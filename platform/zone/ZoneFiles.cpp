#include "zone/ZoneFiles.h"

#include "common/FileLock.h"
#include "logger/LogLine.h"
#include "vk/FileDescriptor.h"
#include "zone/ZoneInForce.h"
#include "zone/ZoneMemory.h"

#include <cerrno>
#include <cstdlib>
#include <ctime>
#include <fcntl.h>
#include <optional>
#include <sys/stat.h>
#include <unistd.h>

namespace VK::Zone {

namespace {

const std::string zoneNameFile = "/etc/timezone";

/// Opens a directory, made with those above it where they are missing: a descriptor or a negative errno value.
int openDirectory(const Root& root, const std::string& path) {
    const int fd = root.open(path, O_RDONLY | O_DIRECTORY);
    if (fd != -ENOENT || path == "/") return fd;
    const std::size_t slash = path.rfind('/');
    const int above = openDirectory(root, slash == 0 ? "/" : path.substr(0, slash));
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
    const std::string name = zoneNameOf(localTime.content);
    return name.empty() ? localTime.content : name;
}

/// The zone directory's name for a zone that always has that offset. Its signs are those of POSIX: west is positive.
std::string nameOfOffset(const Root& root, int minutes) {
    if (minutes % 60 != 0) return {};
    std::string name = "Etc/GMT";
    if (minutes != 0) name += (minutes > 0 ? "-" : "+") + std::to_string(std::abs(minutes) / 60);
    const std::optional<TimeZone> zone = zoneOfFile(root, zoneDirectory + name);
    const bool right = zone && zone->at(0).offset == minutes * 60 && !zone->hasDaylightSavingFrom(0);
    return right ? name : std::string();
}

/// Whether a zone would be in force if /etc/localtime were that. With none there it is UTC.
bool makesZone(const Root& root, const SavedFile& localTime) {
    const std::string& content = localTime.content;
    switch (localTime.kind) {
    case SavedFile::Link:
        return zoneOfFile(root, content.front() == '/' ? content : "/etc/" + content).has_value();
    case SavedFile::File:
        return parseZoneFile(content).has_value();
    default:
        return true;
    }
}

/// Whether /etc/localtime is that and puts a zone into force.
bool isInForce(const Root& root, const SavedFile& wanted) {
    SavedFile found;
    return lookAt(root, localTimeFile, found) == 0 && found == wanted &&
           (wanted.kind == SavedFile::Absent || zoneOfFile(root, localTimeFile).has_value());
}

/// What /etc/localtime and /etc/timezone are to be for a zone of that offset.
SavedZone zoneOfOffset(const Root& root, int minutes) {
    SavedZone zone;
    zone.zoneName.kind = SavedFile::File;
    if (const std::string name = nameOfOffset(root, minutes); !name.empty()) {
        zone.localTime = {SavedFile::Link, ".." + zoneDirectory + name};
        // Where /etc is itself a link, the directory above it is not the root.
        if (!makesZone(root, zone.localTime)) zone.localTime.content = zoneDirectory + name;
        zone.zoneName.content = name + "\n";
    } else {
        zone.localTime = {SavedFile::File, makeZoneFile(minutes)};
        zone.zoneName.content = describeBytes(zone.localTime.content) + "\n";
    }
    return zone;
}

void logDamage(const ZoneMemory& memory) {
    if (!memory.damage().empty()) logLine(failure, "replace", __LINE__, memory.damage());
}

ZoneFiles::State stateOf(const Root& root, const SavedFile& localTime) {
    return {describe(localTime), offsetInForce(root), hasDaylightSaving(root)};
}

} // namespace

/// What a change holds on to until it is done.
struct ZoneFiles::Session {
    FileDescriptor state;
    FileDescriptor etc;
    std::optional<FileLock> lock;
    std::optional<ZoneMemory> memory;
    SavedZone present;
    int zoneNameError = 0; ///< why /etc/timezone cannot be seen
};

bool ZoneFiles::fail(const std::string& what, int error) {
    reason = what;
    if (error != 0) reason += ": " + errorText(error);
    if (error == EACCES || error == EPERM) reason += "; this takes root, or the privilege CAP_DAC_OVERRIDE";
    return false;
}

bool ZoneFiles::begin(Session& session) {
    const int state = openDirectory(root, ZoneMemory::stateDirectory);
    session.state = FileDescriptor(state);
    if (state < 0) return fail(ZoneMemory::stateDirectory, -state);
    const int etc = root.open("/etc", O_RDONLY | O_DIRECTORY);
    session.etc = FileDescriptor(etc);
    if (etc < 0) return fail("/etc", -etc);
    session.lock.emplace(state, "lock");
    if (const int error = session.lock->error(); error != 0) return fail(ZoneMemory::stateDirectory + "/lock", error);
    if (const int error = lookAt(root, localTimeFile, session.present.localTime); error != 0)
        return fail(localTimeFile, error);
    session.zoneNameError = lookAt(root, zoneNameFile, session.present.zoneName);
    session.memory.emplace(root, state);
    old = stateOf(root, session.present.localTime);
    return true;
}

/// The name is for people and old programs: the zone is in force without it.
void ZoneFiles::putName(const Session& session, const SavedFile& wanted, int from) const {
    if (wanted.kind == SavedFile::Absent) return;
    int error = session.zoneNameError;
    if (error == 0 && session.present.zoneName.kind == SavedFile::Absent) return;
    // One that cannot be read could not be brought back.
    if (error == 0) error = putBack(session.etc.get(), "timezone", wanted, from);
    if (error != 0) logLine(failure, "put", __LINE__, zoneNameFile + " does not follow: " + errorText(error));
}

/// `from` is a descriptor of the directory that holds what is wanted, or -1.
bool ZoneFiles::put(const Session& session, const SavedZone& wanted, int from) {
    if (const int error = putBack(session.etc.get(), "localtime", wanted.localTime, from); error != 0)
        return fail(localTimeFile, error);
    if (!isInForce(root, wanted.localTime)) {
        const int error = putBack(session.etc.get(), "localtime", session.present.localTime);
        return fail(localTimeFile + ": another zone was put into force" + (error == 0 ? "" : " and stays"), error);
    }
    putName(session, wanted.zoneName, from);
    now = stateOf(root, wanted.localTime);
    done = true;
    return true;
}

bool ZoneFiles::replace(Session& session, int minutes, bool keepsOlder) {
    ZoneMemory& memory = *session.memory;
    memory.recover(session.present.localTime);
    std::optional<SavedZone> older;
    if (const int error = memory.read(older); error != 0) return fail(ZoneMemory::stateDirectory, error);
    logDamage(memory);
    if (older && keepsOlder) return put(session, zoneOfOffset(root, minutes), -1);
    // Remembered before the zone changes: at no time is there a change that cannot be taken back.
    if (const int error = memory.keep(session.etc.get(), session.present); error != 0)
        return fail(ZoneMemory::stateDirectory, error);
    const bool isPut = put(session, zoneOfOffset(root, minutes), -1);
    if (SavedFile found; lookAt(root, localTimeFile, found) == 0 && found == session.present.localTime)
        memory.revert();
    else
        memory.commit();
    return isPut;
}

bool ZoneFiles::putOffset(int minutes) {
    Session session;
    return begin(session) && (old.offset == minutes || replace(session, minutes, true));
}

bool ZoneFiles::dropDaylightSaving() {
    Session session;
    if (!begin(session)) return false;
    return !old.daylightSaving || replace(session, zoneInForce(root).standardOffsetAt(std::time(nullptr)) / 60, false);
}

bool ZoneFiles::bringBack() {
    const std::string nothing = "no zone with daylight saving was replaced";
    if (!ZoneMemory::exists(root)) return fail(nothing);
    Session session;
    if (!begin(session)) return false;
    if (old.daylightSaving) return true;
    ZoneMemory& memory = *session.memory;
    memory.recover(session.present.localTime);
    std::optional<SavedZone> zone;
    if (const int error = memory.read(zone); error != 0) return fail(ZoneMemory::stateDirectory, error);
    if (!zone) return fail(memory.damage().empty() ? nothing : memory.damage());
    logDamage(memory);
    if (!makesZone(root, zone->localTime))
        return fail(describe(zone->localTime) + ", which was replaced, is no zone now");
    if (!(zone->localTime == session.present.localTime) && !put(session, *zone, memory.open().get())) return false;
    memory.forget();
    return true;
}

} // namespace VK::Zone
