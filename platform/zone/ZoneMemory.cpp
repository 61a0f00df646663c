#include "zone/ZoneMemory.h"

#include "common/AtomicFile.h"
#include "zone/ZoneFile.h"

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace VK::Zone {

namespace {

const std::string NAME = "former-zone";
const std::string ASIDE = NAME + ".old";      // of the memory before, while a change is under way
const std::string SCRATCH = NAME + ".vk-new"; // of what is being made or removed
const std::string NO_LOCAL_TIME = "no-localtime";
const std::string OF_FIRST_VERSION = "replaced-zone";

int fill(int folder, const SavedZone& zone, int etc) {
    const FileOwner owner{0644, geteuid(), getegid()};
    const int error = zone.localTime.kind == SavedFile::Absent ? replaceFile(folder, NO_LOCAL_TIME, "", owner)
                                                               : putBack(folder, "localtime", zone.localTime, etc);
    return error != 0 ? error : putBack(folder, "timezone", zone.zoneName, etc);
}

/// A link may lead nowhere for a while; bytes that are no zone file never become one.
bool isWhole(const SavedFile& localTime) {
    return localTime.kind != SavedFile::File || parseZoneFile(localTime.content).has_value();
}

} // namespace

const std::string ZoneMemory::FOLDER = "/var/lib/vk/instrumentation";

bool ZoneMemory::exists(const Root& root) {
    for (const std::string& name : {NAME, ASIDE, OF_FIRST_VERSION})
        if (root.exists(FOLDER + "/" + name)) return true;
    return false;
}

bool ZoneMemory::has(const std::string& name) const {
    struct stat status {};
    return fstatat(state, name.c_str(), &status, AT_SYMLINK_NOFOLLOW) == 0;
}

int ZoneMemory::move(const std::string& from, const std::string& to) {
    if (renameat(state, from.c_str(), state, to.c_str()) != 0) return errno;
    fsync(state);
    return 0;
}

void ZoneMemory::remove(const std::string& name) {
    const FileDescriptor folder(openat(state, name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!folder) return;
    for (const std::string& each : root.list(FOLDER + "/" + name).names) unlinkat(folder.get(), each.c_str(), 0);
    unlinkat(state, name.c_str(), AT_REMOVEDIR);
}

/// Half a memory must never stand under its name.
void ZoneMemory::discard(const std::string& name) {
    remove(SCRATCH);
    if (move(name, SCRATCH) == 0) remove(SCRATCH);
}

void ZoneMemory::recover(const SavedFile& localTime) {
    if (!has(ASIDE)) return;
    const std::optional<SavedZone> zone = load();
    if (!has(NAME) || (zone && zone->localTime == localTime))
        revert();
    else if (zone)
        commit();
}

std::optional<SavedZone> ZoneMemory::load() const {
    const std::string folder = FOLDER + "/" + NAME + "/";
    SavedZone zone;
    if (lookAt(root, folder + "localtime", zone.localTime) != 0) return std::nullopt;
    if (zone.localTime.kind == SavedFile::Absent && !root.exists(folder + NO_LOCAL_TIME)) return std::nullopt;
    if (!isWhole(zone.localTime)) return std::nullopt;
    if (lookAt(root, folder + "timezone", zone.zoneName) != 0) zone.zoneName = {}; // the name is only for people
    return zone;
}

int ZoneMemory::setAside(const std::string& name, const char* why) {
    std::string other = name + ".damaged";
    for (int number = 2; has(other); ++number) other = name + ".damaged-" + std::to_string(number);
    const int error = move(name, other);
    if (error == 0) renamed = FOLDER + "/" + name + " " + why + " and is now called " + other;
    return error;
}

int ZoneMemory::migrate() {
    if (!has(OF_FIRST_VERSION)) return 0;
    const Root::Contents bytes = root.read(FOLDER + "/" + OF_FIRST_VERSION, Root::DEFAULT_LIMIT * 3);
    const std::optional<SavedZone> zone = bytes ? readSavedZone(bytes.text) : std::nullopt;
    if (!zone || !isWhole(zone->localTime)) return setAside(OF_FIRST_VERSION, "is damaged");
    if (!has(NAME))
        if (const int error = keep(-1, *zone); error != 0) return error;
    if (load() == zone) return removeFile(state, OF_FIRST_VERSION);
    return setAside(OF_FIRST_VERSION, "is not what was remembered last");
}

int ZoneMemory::read(std::optional<SavedZone>& zone) {
    if (const int error = migrate(); error != 0) return error;
    zone = load();
    if (zone || !has(NAME)) return 0;
    if (const int error = setAside(NAME, "is damaged"); error != 0) return error;
    if (move(ASIDE, NAME) == 0) zone = load();
    return 0;
}

int ZoneMemory::keep(int etc, const SavedZone& zone) {
    remove(SCRATCH);
    if (mkdirat(state, SCRATCH.c_str(), 0755) != 0) return errno;
    const FileDescriptor folder(openat(state, SCRATCH.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    int error = folder ? fill(folder.get(), zone, etc) : errno;
    if (error == 0 && has(NAME)) error = move(NAME, ASIDE);
    if (error == 0) error = move(SCRATCH, NAME);
    if (error == 0) return 0;
    remove(SCRATCH);
    if (!has(NAME)) move(ASIDE, NAME);
    return error;
}

void ZoneMemory::commit() {
    discard(ASIDE);
}

void ZoneMemory::revert() {
    discard(NAME);
    move(ASIDE, NAME);
}

void ZoneMemory::forget() {
    discard(NAME);
}

FileDescriptor ZoneMemory::open() const {
    return FileDescriptor(openat(state, NAME.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
}

} // namespace VK::Zone
