#include "platform/providerutilities/RecordedLog.h"

#pragma GCC visibility push(default) // so that the libraries' calls arrive here
#include "nvlog/NVLogger.h"

#include <utility>

namespace {

std::vector<std::string> lines;

void record(const char* channel, int level, const std::string& category, const std::string& text) {
    lines.push_back(std::string(channel) + " " + std::to_string(level) + " " + category + " " + text);
}

} // namespace

void NVLog::NVLogger::logLevelMessage(const char*, const char*, int, const std::string& category, int level, char*, int,
                                      int, const std::string& text) {
    record("LOG", level, category, text);
}

void NVLog::NVLogger::traceLevelMessage(const char*, const char*, int, const std::string& category, int level, char*,
                                        int, int, const std::string& text) {
    record("TRACE", level, category, text);
}

std::vector<std::string> takeLog() {
    return std::exchange(lines, {});
}
