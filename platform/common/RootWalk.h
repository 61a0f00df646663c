#pragma once

#include "vk/FileDescriptor.h"

#include <string>
#include <sys/types.h>
#include <utility>
#include <vector>

namespace VK {

/// Follows a path below a directory one name at a time, symbolic links by hand, without ever leaving the directory,
/// also while somebody renames what is being walked. What the kernel's RESOLVE_IN_ROOT does, for kernels and sandboxes
/// without it, and with the names walked through.
class RootWalk {
public:
    explicit RootWalk(FileDescriptor rootDirectory) : root(std::move(rootDirectory)) {}

    /// Walks to the path: 0, or an errno value. With `followLast` a link at its end is followed too.
    int walk(const std::string& path, bool followLast);

    /// After ENOENT: whether everything but the path's last name is there, so that `open` can make it.
    bool onlyLastNameIsMissing() const { return !missing.empty(); }

    /// Opens what was walked to (or makes it, with O_CREAT): a descriptor or a negative errno value.
    int open(int flags, mode_t mode) const;

    /// Where the walk stands: absolute below the root.
    std::string path() const;

    /// The same; after ENOENT the first path on the way that is not there.
    std::string end() const { return absent.empty() ? path() : absent; }

    /// Each link that was followed, absolute below the root, with no other on the way to it.
    const std::vector<std::string>& links() const { return followed; }

private:
    struct Step {
        std::string name;
        FileDescriptor fd;
    };

    int enter(const std::string& name, bool followLink);
    int follow(const FileDescriptor& link);
    void defer(const std::string& path);
    std::string below(const std::string& name) const;
    int top() const { return steps.empty() ? root.get() : steps.back().fd.get(); }

    FileDescriptor root;
    std::vector<Step> steps;          ///< from below the root to here
    std::vector<std::string> pending; ///< names still to walk, the next one last
    std::string missing;              ///< the last name, when nothing is there
    std::string absent;               ///< the path that a walk ended before
    std::vector<std::string> followed;
};

} // namespace VK
