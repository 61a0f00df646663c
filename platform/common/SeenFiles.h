#pragma once

#include "common/FileStamp.h"
#include "vk/Root.h"

#include <cstdint>
#include <string>
#include <vector>

namespace VK {

/// Files that something was made of, and what they were like: one lstat of each, which takes no descriptor, shows
/// whether they changed. Links on the way to a file count as files of their own; a file that is missing counts by the
/// first name that is not there.
class SeenFiles {
public:
    /// To be made, and its files added, before they are read.
    explicit SeenFiles(const Root& hostRoot) : root(hostRoot), begin(FileStamp::now()) {}

    /// What a path leads to, and the links on the way.
    void add(const std::string& path) { follow(path, true); }
    /// The links on the way alone.
    void addLinks(const std::string& path) { follow(path, false); }

    /// Whether nothing was made, changed or removed since. False also where that cannot be known: a file is as young as
    /// the file system's clock is coarse, or lies in a file system whose stamps do not show each change.
    bool unchanged() const;

private:
    struct Seen {
        std::string file; ///< as this process sees it
        FileStamp stamp;
    };

    void follow(const std::string& path, bool withEnd);
    void look(const std::string& path);

    const Root& root;
    const std::int64_t begin;
    std::vector<Seen> files;
    bool settled = true; ///< the stamps show every later change
};

} // namespace VK
