#pragma once

#include "tools/snapshot/Mask.h"
#include "tools/snapshot/Target.h"
#include "vk/Root.h"

#include <functional>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace snapshot {

/// Copies the files that reading a host opens.
class Snapshot {
public:
    /// Without a mask all is copied unchanged; without a host name the host's own is written. `checkpoint` is called
    /// between two files, and ends the copying by what it throws.
    struct Options {
        Mask* mask = nullptr;
        std::optional<std::string> hostName = std::nullopt;
        std::function<void()> checkpoint = [] {};
    };

    Snapshot(const VK::Root& hostRoot, Target& newDirectory, Options wanted)
        : root(hostRoot), target(newDirectory), options(std::move(wanted)) {}

    /// `read` reads all that is of interest of the host below a root.
    void take(const std::function<void(const VK::Root&)>& read);

    std::size_t count() const { return copied.size(); }
    /// Files that are there and cannot be read, each with the reason.
    const std::vector<std::string>& problems() const { return refused; }

private:
    std::vector<std::string> takeRecord(const std::function<void(const VK::Root&)>& read);
    void planFollowed(const std::string& path, std::vector<std::string>& files);
    void copy(const std::string& path);
    void copyPlain(const std::string& path);
    void writeAnswers();
    std::optional<std::string> contentsOf(const std::string& path);
    void write(const std::string& path, const std::string& bytes);

    const VK::Root& root;
    Target& target;
    Options options;
    std::string entryPoint;                                 ///< of the tables, as far as copied
    std::vector<std::pair<std::string, std::string>> links; ///< paths and where they lead
    std::vector<std::string> plain;                         ///< files that hold nothing to mask
    std::set<std::string> copied;
    std::vector<std::string> refused;
};

} // namespace snapshot
