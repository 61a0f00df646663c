#include "zone/SavedFile.h"

#include "common/AtomicFile.h"

#include <cerrno>
#include <unistd.h>

namespace VK::Zone {

namespace {

constexpr std::string_view HEADER = "vk-zone 1\n";
constexpr std::string_view KINDS[] = {"absent", "link", "file"};

void append(std::string& bytes, const SavedFile& file) {
    bytes += KINDS[file.kind];
    bytes += " " + std::to_string(file.content.size()) + "\n" + file.content + "\n";
}

/// Takes what `append` wrote off the front.
bool take(std::string_view& bytes, SavedFile& file) {
    const std::size_t blank = bytes.find(' ');
    const std::size_t end = bytes.find('\n');
    if (blank == std::string_view::npos || end == std::string_view::npos || blank > end) return false;
    const std::string_view digits = bytes.substr(blank + 1, end - blank - 1);
    const bool number = !digits.empty() && digits.size() < 9 && digits.find_first_not_of("0123456789") == digits.npos;
    for (const auto kind : {SavedFile::Absent, SavedFile::Link, SavedFile::File}) {
        if (!number || bytes.substr(0, blank) != KINDS[kind]) continue;
        const std::size_t length = std::stoul(std::string(digits));
        bytes.remove_prefix(end + 1);
        if (bytes.size() <= length || bytes[length] != '\n') return false;
        file.kind = kind;
        file.content = bytes.substr(0, length);
        bytes.remove_prefix(length + 1);
        return true;
    }
    return false;
}

} // namespace

int lookAt(const Root& root, const std::string& path, SavedFile& found) {
    found = SavedFile();
    const Root::Contents link = root.readLink(path);
    if (link.error == ENOENT) return 0;
    if (link) {
        found.kind = SavedFile::Link;
        found.content = link.text;
        return 0;
    }
    if (link.error != EINVAL) return link.error;
    const Root::Contents file = root.read(path);
    if (!file) return file.error;
    if (file.truncated) return EFBIG;
    found.kind = SavedFile::File;
    found.content = file.text;
    return 0;
}

int putBack(int folder, const std::string& name, const SavedFile& saved) {
    switch (saved.kind) {
    case SavedFile::Link:
        return replaceLink(folder, name, saved.content);
    case SavedFile::File:
        return replaceFile(folder, name, saved.content, FileOwner{0644, geteuid(), getegid()});
    default:
        return unlinkat(folder, name.c_str(), 0) == 0 || errno == ENOENT ? 0 : errno;
    }
}

std::string writeSavedZone(const SavedZone& zone) {
    std::string bytes(HEADER);
    append(bytes, zone.localTime);
    append(bytes, zone.zoneName);
    return bytes;
}

std::optional<SavedZone> readSavedZone(std::string_view bytes) {
    if (bytes.substr(0, HEADER.size()) != HEADER) return std::nullopt;
    bytes.remove_prefix(HEADER.size());
    SavedZone zone;
    if (!take(bytes, zone.localTime) || !take(bytes, zone.zoneName) || !bytes.empty()) return std::nullopt;
    return zone;
}

} // namespace VK::Zone
