#include "tools/snapshot/Snapshot.h"

#include "tools/snapshot/MaskedFiles.h"

#include "host/State.h"
#include "logger/LogLine.h"
#include "vk/Architecture.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <filesystem>

namespace snapshot {

using VK::Root;
using Paths = std::vector<std::string>;

namespace {

const std::string hostNameFile = "/etc/hostname";
const std::string architecture = "/proc/sys/kernel/arch";

/// What the kernel supplies for the running host, and the file that names the host's users.
const std::set<std::string> neverCopied = {hostNameFile, architecture, "/run/utmp"};

/// What describing the host does not read: files for the product's identifier and for changes of zone and clock.
/// The last one names the board, for developers.
const Paths alsoCopied = {"/etc/machine-id", "/etc/timezone", "/etc/adjtime", "/proc/device-tree/compatible"};

/// Each once, where it stands first.
Paths unique(Paths paths) {
    std::set<std::string> seen = neverCopied;
    std::erase_if(paths, [&seen](const std::string& path) { return !seen.insert(path).second; });
    return paths;
}

bool isDirectory(const Root& root, const std::string& path) {
    return bool(VK::FileDescriptor(root.open(path, O_PATH | O_DIRECTORY)));
}

} // namespace

/// The files that reading opened. An empty host is read as well, which opens every source: each is read only where
/// those before it say nothing.
Paths Snapshot::takeRecord(const std::function<void(const Root&)>& read) {
    Root::Record record;
    read(root.recordedIn(record));
    const Root nothing(target.getPath(), true); // nothing is in it so far
    read(nothing.recordedIn(record));
    Paths files = record.read;
    files.insert(files.end(), alsoCopied.begin(), alsoCopied.end());
    files = unique(std::move(files));
    for (const std::string& path : unique(record.followed)) planFollowed(path, files);
    return files;
}

/// A path that may be a link is copied as a link, and what was read is copied to where it leads.
void Snapshot::planFollowed(const std::string& path, Paths& files) {
    if (isDirectory(root, path)) return;
    const Root::Contents end = root.resolve(path);
    const bool wasRead = end && std::erase(files, end.text) > 0;
    if (const Root::Contents link = root.readLink(path)) {
        links.emplace_back(path, link.text);
        if (!end && end.error != ENOENT) refused.push_back(path + ": " + VK::errorText(end.error));
        if (wasRead)
            plain.push_back((std::filesystem::path(path).parent_path() / link.text).lexically_normal().string());
    } else if (wasRead) {
        plain.push_back(path);
    }
}

void Snapshot::take(const std::function<void(const Root&)>& read) {
    Paths files = takeRecord(read);
    std::stable_sort(files.begin(), files.end(), [](const std::string& a, const std::string& b) {
        return contentOf(a) < contentOf(b); // serial numbers first
    });
    for (const std::string& path : files) copy(path);
    writeAnswers();
    for (const auto& [path, leadsTo] : links) {
        options.checkpoint();
        target.link(path.substr(1), leadsTo);
        copied.insert(path);
    }
    for (const std::string& path : plain)
        if (!copied.contains(path)) copyPlain(path);
    options.checkpoint();
}

void Snapshot::writeAnswers() {
    const std::string name = options.hostName ? *options.hostName : VK::Host::hostName(root).value_or("");
    write(hostNameFile, name + "\n");
    write(architecture, VK::architectureOf(root) + "\n");
}

/// Also nothing for what is there and is no file.
std::optional<std::string> Snapshot::contentsOf(const std::string& path) {
    const Root::Contents contents = root.read(path);
    if (contents) return contents.text;
    if (contents.error != ENOENT && contents.error != EISDIR && contents.error != EINVAL)
        refused.push_back(path + ": " + VK::errorText(contents.error));
    return std::nullopt;
}

void Snapshot::copy(const std::string& path) {
    std::optional<std::string> bytes = contentsOf(path);
    if (!bytes) return;
    const Content content = contentOf(path);
    if (content == Content::EntryPoint) entryPoint = *bytes;
    write(path, options.mask != nullptr ? maskedFile(content, *bytes, entryPoint, *options.mask) : *bytes);
}

void Snapshot::copyPlain(const std::string& path) {
    if (const std::optional<std::string> bytes = contentsOf(path)) write(path, *bytes);
}

void Snapshot::write(const std::string& path, const std::string& bytes) {
    options.checkpoint();
    target.write(path.substr(1), bytes);
    copied.insert(path);
}

} // namespace snapshot
