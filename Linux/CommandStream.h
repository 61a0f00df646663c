#pragma once

#include <cstdio>

namespace VK::BaseServerProvider {

/// A shell command whose output is read (popen, mode as given). The command is waited for when the object goes; its
/// exit status is not looked at. The descriptor is close-on-exec, so that commands started meanwhile do not hold it.
class CommandStream {
public:
    CommandStream(const char* command, const char* mode);
    ~CommandStream();
    CommandStream(const CommandStream&) = delete;
    CommandStream& operator=(const CommandStream&) = delete;

    /// Whether the command could be started.
    explicit operator bool() const { return stream != nullptr; }

    /// Reads one line, its line feed included, of at most `size` - 1 bytes; false at the end of the output, with the
    /// buffer untouched.
    bool readLine(char* buffer, int size) { return std::fgets(buffer, size, stream) != nullptr; }

private:
    std::FILE* const stream;
};

} // namespace VK::BaseServerProvider
