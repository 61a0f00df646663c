#pragma once

#include "vk/FileDescriptor.h"
#include "zone/SavedFile.h"

#include <optional>
#include <string>

namespace VK::Zone {

/// What /etc/localtime and /etc/timezone were before a change: the directory `former-zone` of the state directory. It
/// holds the very link or file under the names `localtime` and `timezone`; an empty file `no-localtime` says that
/// there was none. It is made beside and renamed, so it is whole or missing, and it is there before /etc/localtime
/// changes. A memory that it takes the place of waits as `former-zone.old` until the change is in force.
///
/// The operations are for one at a time, under the lock of the state directory. The package's script for purging
/// reads the directory too.
class ZoneMemory {
public:
    /// The state directory.
    static const std::string stateDirectory;

    /// Whether there is a memory, damaged or not.
    static bool exists(const Root& root);

    /// `descriptor` is the state directory's.
    ZoneMemory(const Root& hostRoot, int descriptor) : root(hostRoot), state(descriptor) {}

    /// Ends a change that was interrupted: as its own end would have done if /etc/localtime is no longer what was
    /// remembered, else as its failure would have.
    void recover(const SavedFile& localTime);

    /// What is remembered, or nothing; also what version 1.0.0 remembered, which takes the present form. A damaged
    /// memory does not count and is renamed. 0, or the errno value.
    int read(std::optional<SavedZone>& zone);
    /// What `read` renamed, for people; else empty.
    const std::string& damage() const { return renamed; }

    /// Remembers what a change is about to replace, and puts aside what was remembered before. `etc` is a descriptor
    /// of /etc. 0, or the errno value; then all is as before.
    int keep(int etc, const SavedZone& zone);
    /// The change is in force: what was put aside goes.
    void commit();
    /// The change is not in force: what was put aside is remembered again.
    void revert();
    /// The zone has been brought back.
    void forget();

    /// The memory's directory.
    FileDescriptor open() const;

private:
    bool has(const std::string& name) const;
    int move(const std::string& from, const std::string& to);
    void remove(const std::string& name);
    void discard(const std::string& name);
    std::optional<SavedZone> load() const;
    int migrate();
    int setAside(const std::string& name, const char* reason);

    const Root& root;
    const int state;
    std::string renamed;
};

} // namespace VK::Zone
