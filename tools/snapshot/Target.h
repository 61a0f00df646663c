#pragma once

#include "vk/FileDescriptor.h"

#include <filesystem>
#include <map>
#include <stdexcept>
#include <string>
#include <string_view>
#include <sys/types.h>
#include <vector>

namespace snapshot {

/// What users other than the owner may do with a file; nothing of a snapshot is for them.
constexpr mode_t forOthers = 077;

/// A file or directory that cannot be made, or a directory that is not to be written to; says which and why.
class Failure : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
    Failure(const std::filesystem::path& path, int error);
};

/// The directory of a snapshot: no path is followed below it that this run did not make.
class Target {
public:
    /// Makes the directory where it is missing. One that exists is taken if it is empty, its user's own and closed to
    /// others. Below one that others use a new one is made. Nothing is left of it where that fails.
    explicit Target(const std::filesystem::path& directory);

    void write(const std::string& name, std::string_view bytes);
    void link(const std::string& name, const std::string& target);

    /// Removes everything that this run made: false where something of it stays.
    bool remove();

    const std::filesystem::path& getPath() const { return path; }

private:
    void openItself();
    void makeMissing(const std::filesystem::path& directory);
    void makeOwnBelow();
    bool removeMade();
    int open(const std::string& directory, const std::string& forName);
    [[noreturn]] void fail(const std::string& name) const;

    std::filesystem::path path;
    std::vector<std::filesystem::path> made;               ///< the directory and those above it, as far as made here
    std::map<std::string, VK::FileDescriptor> directories; ///< below it, by name
    std::vector<std::string> entries;                      ///< files and links
};

} // namespace snapshot
