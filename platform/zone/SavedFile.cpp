#include "zone/SavedFile.h"

#include "common/AtomicFile.h"

#include <cerrno>
#include <unistd.h>

namespace VK::Zone {

namespace {

constexpr std::string_view magic = "vk-zone 1\n";
constexpr std::string_view kinds[] = {"absent", "link", "file"};

/// Takes one of the two off the front.
bool take(std::string_view& bytes, SavedFile& file) {
    const std::size_t blank = bytes.find(' ');
    const std::size_t end = bytes.find('\n');
    if (blank == std::string_view::npos || end == std::string_view::npos || blank > end) return false;
    const std::string_view digits = bytes.substr(blank + 1, end - blank - 1);
    const bool number = !digits.empty() && digits.size() < 9 && digits.find_first_not_of("0123456789") == digits.npos;
    for (const auto kind : {SavedFile::Absent, SavedFile::Link, SavedFile::File}) {
        if (!number || bytes.substr(0, blank) != kinds[kind]) continue;
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

int putBack(int directory, const std::string& name, const SavedFile& saved, int from) {
    if (saved.kind == SavedFile::Absent) return removeFile(directory, name);
    if (from >= 0 && replaceByLinking(directory, name, from) == 0) return 0;
    if (saved.kind == SavedFile::Link) return replaceLink(directory, name, saved.content);
    return replaceFile(directory, name, saved.content, FileOwner{0644, geteuid(), getegid()});
}

std::optional<SavedZone> readSavedZone(std::string_view bytes) {
    if (bytes.substr(0, magic.size()) != magic) return std::nullopt;
    bytes.remove_prefix(magic.size());
    SavedZone zone;
    if (!take(bytes, zone.localTime) || !take(bytes, zone.zoneName) || !bytes.empty()) return std::nullopt;
    return zone;
}

} // namespace VK::Zone
