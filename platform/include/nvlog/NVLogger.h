#pragma once

#include <string>

namespace NVLog {

/// The product's logger: two channels, each of which keeps or drops a line by its level.
///
/// Where lines go and which are kept is read once per process, with secure_getenv:
/// `NVLOG_SINK` (`syslog`, `stderr`, `file:PATH`, `none`; default `syslog`), `NVLOG_LEVELS` (comma-separated levels
/// or `all`; default `3000,6000`) and `NVLOG_CHANNELS` (`log`, `trace` or both; default `log` for syslog, else both).
///
/// Both operations may be called from any thread at any time. They never throw, never start a thread and never call
/// openlog or closelog; a sink that cannot be opened falls back to syslog. A dropped line costs one table look-up.
class NVLogger {
public:
    /// Writes one line to the log channel. `function`, `file` and `line` tell where the event happened, `category`
    /// whose event it is, `level` how grave it is (3000 notice, 6000 failure, 4000 and others debug).
    /// The `char*` and the two integers after it are not used.
    static void logLevelMessage(const char* function, const char* file, int line, const std::string& category,
                                int level, char* reserved, int reserved1, int reserved2, const std::string& text);

    /// Writes one line to the trace channel; arguments as above.
    static void traceLevelMessage(const char* function, const char* file, int line, const std::string& category,
                                  int level, char* reserved, int reserved1, int reserved2, const std::string& text);
};

} // namespace NVLog
