#include "Linux/CommandStream.h"

#include <fcntl.h>

namespace VK::BaseServerProvider {

CommandStream::CommandStream(const char* command, const char* mode)
    : stream(popen(command, mode)) { // NOLINT(cert-env33-c): running these commands is what the class is for
    if (stream != nullptr) fcntl(fileno(stream), F_SETFD, FD_CLOEXEC);
}

CommandStream::~CommandStream() {
    if (stream != nullptr) pclose(stream);
}

} // namespace VK::BaseServerProvider
