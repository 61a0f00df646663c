#pragma once

#include <string>

namespace NVLog {

/// The product's logger: two channels, each of which keeps or drops a line by its level.
///
/// Where lines go and which are kept is read once per process, with secure_getenv:
/// `NVLOG_SINK` (`syslog`, `stderr`, `file:PATH`, `none`; default `syslog`), `NVLOG_LEVELS` (comma-separated levels
/// or `all`; default `3000,6000`) and `NVLOG_CHANNELS` (`log`, `trace` or both; default `log` for syslog, else both).
/// An unknown sink means syslog; entries of a list that cannot be used are passed over, and a list without any usable
/// one means the default. A list of more than 64 levels keeps all.
///
/// A file is made with mode 0640 (less the umask) and opened again when its inode changes or it vanishes; each line is
/// one appending write. A line that its sink does not take, because it cannot be opened, is full, or (a pipe named as
/// file) has no room, goes to syslog instead; there, trace lines are kept only where `NVLOG_CHANNELS` names `trace`.
///
/// Both operations may be called from any thread at any time, and in the child of a fork. They never throw, start a
/// thread, raise a signal, change errno, or call openlog or closelog. A dropped line costs one table look-up.
///
/// In the child of a fork of a process with several threads, lines for syslog go to /dev/log directly, since one of
/// those threads may have held the lock of the C library's syslog, which then nobody gives back. Such a line carries
/// the program's short name, its process and the facility `user`, whatever openlog was given, and no time: the daemon
/// adds it. It is dropped where no daemon listens, or one takes nothing for a second.
class NVLogger {
public:
    /// Writes one line to the log channel. `function`, `file` and `line` say where the event happened, `category`
    /// whose event it is, `level` how grave it is (3000 notice, 6000 failure, 4000 and others debug).
    /// The `char*` and the two integers after it are not used.
    static void logLevelMessage(const char* function, const char* file, int line, const std::string& category,
                                int level, char* reserved, int reserved1, int reserved2, const std::string& text);

    /// Writes one line to the trace channel; arguments as above.
    static void traceLevelMessage(const char* function, const char* file, int line, const std::string& category,
                                  int level, char* reserved, int reserved1, int reserved2, const std::string& text);
};

} // namespace NVLog
