#pragma once

#include <string>
#include <sys/types.h>

namespace VK {

/// Whom a new file is to belong to, and who may use it.
struct FileOwner {
    mode_t mode = 0644;
    uid_t user = 0;
    gid_t group = 0;
};

/// Puts a file with these bytes at `name` in the directory, in place of what is there, at one stroke and surviving a
/// crash: written beside it, synchronised, renamed. Only one writer at a time. 0, or the errno value; then what was
/// there is still there. A user or group that we may not give it is left out.
int replaceFile(int directory, const std::string& name, const std::string& bytes, const FileOwner& owner);

/// The same for a symbolic link.
int replaceLink(int directory, const std::string& name, const std::string& target);

/// The same with what has that name in another directory, `from`: it is the very file or link, under both names. Not
/// possible between file systems (EXDEV).
int replaceByLinking(int directory, const std::string& name, int from);

/// Removes a file or link, surviving a crash; 0 also when there is none.
int removeFile(int directory, const std::string& name);

} // namespace VK
