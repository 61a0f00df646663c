#include "instrumentation/Log.h"

#include "instrumentation/HostText.h"
#include "nvlog/NVLogger.h"

#include <system_error>

namespace VK {
namespace Inside {

void logLine(int level, const char* function, int line, const std::string& text) noexcept {
    try {
        NVLog::NVLogger::logLevelMessage(function, "Instrumentation", line, "Norvane.Instrumentation", level, nullptr,
                                         0, 0, text);
    } catch (...) { // a line that cannot be written is no reason to fail
    }
}

std::string errorText(int error) {
    return std::generic_category().message(error);
}

std::string inQuotes(const std::string& text) {
    constexpr std::size_t LONGEST = 64;
    const bool cut = text.size() > LONGEST;
    return "\"" + printable(text.substr(0, LONGEST)) + (cut ? "…\"" : "\"");
}

} // namespace Inside
} // namespace VK
