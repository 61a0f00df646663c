#pragma once

#include "nvlog/NVLogger.h"

#include "platform/logger/Syslog.h"
#include "support/InChild.h"

#include <functional>
#include <map>
#include <sstream>
#include <string>
#include <vector>

/// Lines logged by a process of their own, which the logger's variables are chosen for.
namespace logging {

using Environment = std::map<std::string, std::string>;

inline void log(const std::string& text, int level = 6000) {
    NVLog::NVLogger::logLevelMessage("run", "NVLoggerTest", 7, "Norvane.Test", level, nullptr, 0, 0, text);
}

inline void trace(const std::string& text, int level = 6000) {
    NVLog::NVLogger::traceLevelMessage("run", "NVLoggerTest", 7, "Norvane.Test", level, nullptr, 0, 0, text);
}

/// Runs in a process with these logger variables; answers what went to syslog, a line each.
[[nodiscard]] inline std::string withEnvironment(const Environment& variables, const std::function<void()>& run) {
    return support::inChild([&] {
        for (const char* name : {"NVLOG_SINK", "NVLOG_LEVELS", "NVLOG_CHANNELS"}) unsetenv(name);
        for (const auto& [name, value] : variables) setenv(name.c_str(), value.c_str(), 1);
        run();
        EXPECT_EQ(openlogCalls(), 0);
        std::string lines;
        for (const std::string& line : takeSyslog()) lines += line + "\n";
        return lines;
    });
}

/// The same where nothing goes to syslog.
inline void quietly(const Environment& variables, const std::function<void()>& run) {
    EXPECT_EQ(withEnvironment(variables, run), "");
}

inline std::vector<std::string> splitLines(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) lines.push_back(line);
    return lines;
}

} // namespace logging
