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

/// Looks at a path: 0, or the errno value why that cannot be told. Links are not followed.
int lookAt(const Root& root, const std::string& path, SavedFile& found);

/// Puts at the name in a folder what was saved, at one stroke: 0, or the errno value.
int putBack(int folder, const std::string& name, const SavedFile& saved);

/// What a change of zone replaced.
struct SavedZone {
    SavedFile localTime; ///< /etc/localtime
    SavedFile zoneName;  ///< /etc/timezone
};

/// As bytes of one file, and back; nothing for bytes that are no such file.
std::string writeSavedZone(const SavedZone& zone);
std::optional<SavedZone> readSavedZone(std::string_view bytes);

} // namespace VK::Zone
