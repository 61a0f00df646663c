#pragma once

#include <cstddef>
#include <string>
#include <sys/types.h>
#include <vector>

namespace VK {

/// The directory below which a host's files lie, and the only way to open one of them.
///
/// Paths are absolute as the host sees them (`/etc/hostname`); a missing first slash is as good. Below a root other
/// than `/` no path leads out of it: absolute links and `..` are taken inside the root, as if it were the process's
/// own. Objects hold no descriptor, are not changed by use and may be used by any thread. Errors come as errno values,
/// so that ENOENT (the host has no such file) differs from EACCES (we may not see it). Nothing is thrown but
/// std::bad_alloc.
class Root {
public:
    /// A file's bytes, a link's target or a path; `error` is 0, or the errno value that says why `text` is empty.
    struct Contents {
        int error = 0;
        std::string text;
        bool truncated = false; ///< the file goes on after `text`

        explicit operator bool() const { return error == 0; }
    };

    /// A directory's entries in alphabetical order, without `.` and `..`.
    struct Names {
        int error = 0;
        std::vector<std::string> names;

        explicit operator bool() const { return error == 0; }
    };

    /// What a root was asked for, in order.
    struct Record {
        std::vector<std::string> read;     ///< files to read, there or not
        std::vector<std::string> followed; ///< paths that may be links or lead through some
    };

    /// How much is read of any file unless a caller says otherwise.
    static constexpr std::size_t defaultLimit = std::size_t{1} << 20;

    /// The root at the directory `where`; a relative one is taken from the working directory of now. Where it cannot be
    /// reached, every operation returns why. With `isSnapshot`, a root at `/` is not taken for the running host.
    explicit Root(const std::string& where, bool isSnapshot = false);

    /// The root of the process's host (vk/HostSource.h): the snapshot's directory, else `/`.
    static const Root& host();

    /// The same root, noting in the record what it is asked for. As long as the record lives, and in one thread.
    Root recordedIn(Record& record) const;

    /// Whether these are the running host's own files: this is `/`, and not as a snapshot.
    bool isLive() const { return live; }

    /// The directory, absolute.
    const std::string& getDirectory() const { return directory; }

    /// Reads a regular file from its start, at most `limit` bytes. Files of the kernel, which state no size, are read
    /// to their end too. Never waits: EISDIR for a directory, EINVAL for anything else that is no regular file.
    Contents read(const std::string& path, std::size_t limit = defaultLimit) const;

    /// The target of a symbolic link as it is written there; EINVAL when the path is no link.
    Contents readLink(const std::string& path) const;

    /// The path with every link followed: absolute, without `.` and `..`, as the host sees it (without the root's own
    /// directory). ENOENT when nothing is there.
    Contents resolve(const std::string& path) const;

    /// The names in a directory.
    Names list(const std::string& path) const;

    /// Whether something is at the path, links followed. False also when that cannot be seen.
    bool exists(const std::string& path) const;

    /// Opens with the flags and mode of open(2), close-on-exec and never as controlling terminal: a descriptor that the
    /// caller closes, or a negative errno value. For what the operations above do not do; writing, for example.
    int open(const std::string& path, int flags, mode_t mode = 0) const;

private:
    int openBelow(const std::string& path, int flags, mode_t mode) const;

    std::string directory;
    bool live;
    Record* asked = nullptr;
};

} // namespace VK
