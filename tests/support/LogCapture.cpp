#include "support/LogCapture.h"

#include "nvlog/NVLogger.h"

#include <mutex>
#include <utility>

namespace {

std::mutex mutex;
std::vector<std::string> lines;

} // namespace

namespace support {

std::vector<std::string> takeLog() {
    const std::lock_guard<std::mutex> lock(mutex);
    return std::exchange(lines, {});
}

} // namespace support

namespace NVLog {

__attribute__((visibility("default"))) void NVLogger::logLevelMessage(const char*, const char*, int,
                                                                      const std::string& category, int level, char*,
                                                                      int, int, const std::string& text) {
    const std::lock_guard<std::mutex> lock(mutex);
    if (category == "Norvane.Instrumentation") lines.push_back(std::to_string(level) + " " + text);
}

} // namespace NVLog
