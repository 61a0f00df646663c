#pragma once

#include "vk/Root.h"

#include <optional>
#include <string>
#include <string_view>

namespace VK::Zone {

/// What stands at a path: nothing, a symbolic link or a file.
struct SavedFile {
    enum Kind { Absent, Link, File } kind = Absent;
    std::string content; ///< the link's target or the file's bytes

    friend bool operator==(const SavedFile& a, const SavedFile& b) {
        return a.kind == b.kind && a.content == b.content;
    }
};

/// Looks at a path: 0, or the errno value that says why it cannot be seen. Links are not followed.
int lookAt(const Root& root, const std::string& path, SavedFile& found);

/// Puts at the name in a directory what was saved, at one stroke: 0, or the errno value. Where `from` is a directory
/// that has it under the same name, it becomes the very file with owner, mode and label; between file systems a copy.
int putBack(int directory, const std::string& name, const SavedFile& saved, int from = -1);

/// What a change of zone replaced.
struct SavedZone {
    SavedFile localTime; ///< /etc/localtime
    SavedFile zoneName;  ///< /etc/timezone

    friend bool operator==(const SavedZone& a, const SavedZone& b) {
        return a.localTime == b.localTime && a.zoneName == b.zoneName;
    }
};

/// Reads the one file in which version 1.0.0 remembered a zone: the line `vk-zone 1`, then for each of the two a line
/// `absent 0`, `link LENGTH` or `file LENGTH`, that many bytes and a line end. Nothing for other bytes.
std::optional<SavedZone> readSavedZone(std::string_view bytes);

} // namespace VK::Zone
