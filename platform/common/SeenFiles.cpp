#include "common/SeenFiles.h"

#include "common/RootWalk.h"
#include "vk/Kept.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>

namespace VK {

void SeenFiles::follow(const std::string& path, bool withEnd) {
    FileDescriptor directory(::open(root.getDirectory().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (!directory) {
        noteShortage(errno);
        settled = false;
        return;
    }
    RootWalk walk(std::move(directory));
    const int error = walk.walk(path, true);
    noteShortage(error);
    settled = settled && (error == 0 || error == ENOENT);
    for (const std::string& link : walk.links()) look(link);
    if (withEnd || error == ENOENT) look(walk.end());
}

void SeenFiles::look(const std::string& path) {
    const std::string& directory = root.getDirectory();
    const std::string file = directory == "/" ? path : directory + path;
    if (std::any_of(files.begin(), files.end(), [&file](const Seen& seen) { return seen.file == file; })) return;
    const FileStamp stamp = FileStamp::of(file.c_str());
    settled = settled && stamp.tellsChangesFrom(begin) && hasExactStamps(file);
    files.push_back({file, stamp});
}

bool SeenFiles::unchanged() const {
    return settled && std::all_of(files.begin(), files.end(),
                                  [](const Seen& seen) { return FileStamp::of(seen.file.c_str()) == seen.stamp; });
}

} // namespace VK
