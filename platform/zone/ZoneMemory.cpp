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

const std::string memoryName = "former-zone";
const std::string aside = memoryName + ".old";      // of the memory before, while a change is under way
const std::string scratch = memoryName + ".vk-new"; // of what is being made or removed
const std::string noLocalTime = "no-localtime";
const std::string ofFirstVersion = "replaced-zone";

int fill(int directory, const SavedZone& zone, int etc) {
    const FileOwner owner{0644, geteuid(), getegid()};
    const int error = zone.localTime.kind == SavedFile::Absent ? replaceFile(directory, noLocalTime, "", owner)
                                                               : putBack(directory, "localtime", zone.localTime, etc);
    return error != 0 ? error : putBack(directory, "timezone", zone.zoneName, etc);
}

/// A link may lead nowhere for a while; bytes that are no zone file never become one.
bool isWhole(const SavedFile& localTime) {
    return localTime.kind != SavedFile::File || parseZoneFile(localTime.content).has_value();
}

} // namespace

const std::string ZoneMemory::stateDirectory = "/var/lib/vk/instrumentation";

bool ZoneMemory::exists(const Root& root) {
    for (const std::string& name : {memoryName, aside, ofFirstVersion})
        if (root.exists(stateDirectory + "/" + name)) return true;
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
    const FileDescriptor directory(openat(state, name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!directory) return;
    for (const std::string& each : root.list(stateDirectory + "/" + name).names)
        unlinkat(directory.get(), each.c_str(), 0);
    unlinkat(state, name.c_str(), AT_REMOVEDIR);
}

/// Half a memory must never stand under its name.
void ZoneMemory::discard(const std::string& name) {
    remove(scratch);
    if (move(name, scratch) == 0) remove(scratch);
}

void ZoneMemory::recover(const SavedFile& localTime) {
    if (!has(aside)) return;
    const std::optional<SavedZone> zone = load();
    if (!has(memoryName) || (zone && zone->localTime == localTime))
        revert();
    else if (zone)
        commit();
}

std::optional<SavedZone> ZoneMemory::load() const {
    const std::string directory = stateDirectory + "/" + memoryName + "/";
    SavedZone zone;
    if (lookAt(root, directory + "localtime", zone.localTime) != 0) return std::nullopt;
    if (zone.localTime.kind == SavedFile::Absent && !root.exists(directory + noLocalTime)) return std::nullopt;
    if (!isWhole(zone.localTime)) return std::nullopt;
    if (lookAt(root, directory + "timezone", zone.zoneName) != 0) zone.zoneName = {}; // the name is only for people
    return zone;
}

int ZoneMemory::setAside(const std::string& name, const char* reason) {
    std::string other = name + ".damaged";
    for (int number = 2; has(other); ++number) other = name + ".damaged-" + std::to_string(number);
    const int error = move(name, other);
    if (error == 0) renamed = stateDirectory + "/" + name + " " + reason + " and is now called " + other;
    return error;
}

int ZoneMemory::migrate() {
    if (!has(ofFirstVersion)) return 0;
    const Root::Contents bytes = root.read(stateDirectory + "/" + ofFirstVersion, Root::defaultLimit * 3);
    const std::optional<SavedZone> zone = bytes ? readSavedZone(bytes.text) : std::nullopt;
    if (!zone || !isWhole(zone->localTime)) return setAside(ofFirstVersion, "is damaged");
    if (!has(memoryName))
        if (const int error = keep(-1, *zone); error != 0) return error;
    if (load() == zone) return removeFile(state, ofFirstVersion);
    return setAside(ofFirstVersion, "is not what was remembered last");
}

int ZoneMemory::read(std::optional<SavedZone>& zone) {
    if (const int error = migrate(); error != 0) return error;
    zone = load();
    if (zone || !has(memoryName)) return 0;
    if (const int error = setAside(memoryName, "is damaged"); error != 0) return error;
    if (move(aside, memoryName) == 0) zone = load();
    return 0;
}

int ZoneMemory::keep(int etc, const SavedZone& zone) {
    remove(scratch);
    if (mkdirat(state, scratch.c_str(), 0755) != 0) return errno;
    const FileDescriptor directory(openat(state, scratch.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    int error = directory ? fill(directory.get(), zone, etc) : errno;
    if (error == 0 && has(memoryName)) error = move(memoryName, aside);
    if (error == 0) error = move(scratch, memoryName);
    if (error == 0) return 0;
    remove(scratch);
    if (!has(memoryName)) move(aside, memoryName);
    return error;
}

void ZoneMemory::commit() {
    discard(aside);
}

void ZoneMemory::revert() {
    discard(memoryName);
    move(aside, memoryName);
}

void ZoneMemory::forget() {
    discard(memoryName);
}

FileDescriptor ZoneMemory::open() const {
    return FileDescriptor(openat(state, memoryName.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
}

} // namespace VK::Zone
