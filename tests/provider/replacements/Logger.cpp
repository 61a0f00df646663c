// A logger in place of the product's, with the same headers. It appends the texts it receives to REPLACEMENT_LOG, fails
// where the environment says so, and with REPLACEMENT_KEEPS=1 its buffer never starts anew.
#include "Environment.h"
#include "nvlog/NVLogger.h"
#include "nvlog/NVMessageBuffer.h"

#include <sstream>

#include <fcntl.h>
#include <unistd.h>

namespace {

void record(const char* operation, const char* channel, const std::string& text) {
    const char* const match = replacement::setting("REPLACEMENT_MATCH");
    if (text.find(match) != std::string::npos) replacement::failIn(operation);
    const char* const path = replacement::setting("REPLACEMENT_LOG");
    if (*path == '\0') return;
    const std::string line = std::string(channel) + " " + text + "\n";
    const int file = open(path, O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600);
    if (file < 0 || write(file, line.data(), line.size()) != static_cast<ssize_t>(line.size())) std::abort();
    close(file);
}

} // namespace

namespace NVLog {

struct NVMessageBuffer::Storage {
    std::ostringstream stream;
    std::string handedOut;
};

void NVLogger::logLevelMessage(const char*, const char*, int, const std::string&, int, char*, int, int,
                               const std::string& text) {
    record("log", "LOG", text);
}

void NVLogger::traceLevelMessage(const char*, const char*, int, const std::string&, int, char*, int, int,
                                 const std::string& text) {
    record("trace", "TRACE", text);
}

NVMessageBuffer::NVMessageBuffer() : storage(nullptr) {
    replacement::failIn("make");
    storage = new Storage;
}

NVMessageBuffer::~NVMessageBuffer() {
    delete storage;
}

NVMessageBuffer& NVMessageBuffer::operator<<(const char* text) {
    replacement::failIn("insert");
    storage->stream << (text == nullptr ? "(null)" : text);
    return *this;
}

NVMessageBuffer& NVMessageBuffer::operator<<(char* text) {
    return *this << static_cast<const char*>(text);
}

NVMessageBuffer& NVMessageBuffer::operator<<(unsigned int number) {
    replacement::failIn("insert");
    storage->stream << number;
    return *this;
}

NVMessageBuffer::operator std::ostream&() {
    replacement::failIn("convert");
    return storage->stream;
}

const std::string& NVMessageBuffer::str(NVMessageBuffer& buffer) {
    replacement::failIn("str");
    buffer.storage->handedOut = buffer.storage->stream.str();
    if (!replacement::is("REPLACEMENT_KEEPS", "1")) buffer.storage->stream.str("");
    return buffer.storage->handedOut;
}

const std::string& NVMessageBuffer::str(std::ostream& stream) {
    replacement::failIn("str");
    static thread_local std::string handedOut;
    handedOut = static_cast<std::ostringstream&>(stream).str();
    return handedOut;
}

} // namespace NVLog
