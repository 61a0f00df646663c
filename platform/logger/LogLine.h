#pragma once

#include "nvlog/NVLogger.h"

#include <string>
#include <system_error>

namespace VK {

constexpr int notice = 3000; ///< something of the host was changed, or is kept from us
constexpr int detail = 4000; ///< the host lacks something that hosts may lack
constexpr int failure = 6000;

/// Writes one line under the libraries' category. Never throws, whatever logger stands behind it.
inline void logLine(int level, const char* function, int line, const std::string& text) noexcept {
    try {
        NVLog::NVLogger::logLevelMessage(function, "Instrumentation", line, "Norvane.Instrumentation", level, nullptr,
                                         0, 0, text);
    } catch (...) { // a line that cannot be written is no reason to fail
    }
}

/// What an errno value means, for log lines.
inline std::string errorText(int error) {
    return std::generic_category().message(error);
}

} // namespace VK
