#pragma once

#include "Linux/HostName.h"
#include "Linux/SingleElement.h"
#include "include/Trace.h"
#include "vk/Instrumentation.h"

#include <string>

namespace VK::BaseServerProvider {

/// The host's one time service: its identity, the daylight-saving flag, the clock with its GMT offset, and the NTP
/// daemon. Getters return true when they supplied a value. Actions return 0 for success and 2 for failure. Commands run
/// in the shell and are judged by their first line of output alone, never by their exit status.
class TimeService : public SingleElement {
public:
    TimeService();
    ~TimeService() noexcept(false);

    /// "TimeService@" and the host name.
    bool getName(std::string& name) const;
    bool getCreationClassName(std::string& className) const;
    /// The host name.
    bool getSystemName(std::string& name) const;
    bool getSystemCreationClassName(std::string& className) const;

    /// On purpose, the region can be neither read nor set here: returns false and changes nothing.
    bool getRegion(std::string&) const { return false; }
    bool setRegion(const std::string&) { return false; }

    /// Whether daylight saving is followed automatically. The flag is written in any case: false where it is unknown.
    bool getAutomaticDSTAdjustment(bool& automatic) const;
    bool setAutomaticDSTAdjustment(bool automatic);

    /// Runs a shell command and takes the first line of its output, at most 511 bytes, line feed included; empty when
    /// there was none. False, with `output` untouched, when the command could not be started.
    bool executeCommand(const char* command, const char* mode, std::string& output);

    /// Starts or stops the NTP daemon through its init script, unless it runs, or does not run, already.
    unsigned int StartService();
    unsigned int StopService();

    /// Has ntpd set the clock once. A daemon that was running is stopped before and started again after, and then the
    /// restart's result is returned, on purpose, whatever became of the synchronisation.
    unsigned int SyncClock();

    /// Sets the GMT offset (minutes east of UTC, two's complement), then the clock (seconds since 1970-01-01 UTC), then
    /// synchronises. Ends at the first step that fails.
    unsigned int manageTime(long& time, unsigned int& gmtOffset);

private:
    bool isDaemonRunning();
    unsigned int runInitScript(const char* command);

    char commandOutput[512] = {};
    HostName hostName;
    std::string name;
    Instrumentation instrumentation;
};

} // namespace VK::BaseServerProvider
