#pragma once

#include <string>
#include <vector>

/// A syslog of the test's own: what the logger sent since it was last asked, as `PRIORITY TEXT`.
std::vector<std::string> takeSyslog();

/// What of it was sent to /dev/log directly, whole, since it was last asked.
std::vector<std::string> takeDirectLines();

/// While one of these lives, the C library's syslog waits for it, as it would for another thread's call.
class SyslogIsBusy {
public:
    SyslogIsBusy();
    ~SyslogIsBusy();
    SyslogIsBusy(const SyslogIsBusy&) = delete;
    SyslogIsBusy& operator=(const SyslogIsBusy&) = delete;
};

/// How often openlog and closelog were called, which belong to the object manager.
int openlogCalls();
