#pragma once

#include "Linux/HostName.h"
#include "Linux/SingleElement.h"
#include "include/Trace.h"

#include <string>

namespace VK::BaseServerProvider {

/// The CIM server's settings for delivering indications again, read and changed with the server's `cimconfig` command.
class CIMServiceConfig : public SingleElement {
public:
    CIMServiceConfig();

    bool getName(std::string& name) const;
    bool getCreationClassName(std::string& className) const;
    /// The host name.
    bool getSystemName(std::string& name) const;
    bool getSystemCreationClassName(std::string& className) const;

    /// The directory of the product's CIM server commands, with a final "/": the root directory up to "platform",
    /// followed by "vcm/bin/".
    std::string getbinDirectory() const;

    /// Sets one of the two settings; `value` becomes part of the command as it is. 0 for success, 1 for failure. Waits
    /// for other runs of the command that set something, of this process and, as root, of others.
    unsigned int setIntervalParameter(std::string value);
    unsigned int setAttemptParameter(std::string value);

    /// Reads a setting: the number behind the first ":" of the first line that the command prints, 0 where there is
    /// none. False, with the argument untouched, only when the command could not be started.
    bool getIntervalParameter(unsigned int& seconds) const;
    bool getAttemptParameter(unsigned int& attempts) const;

    /// Sets what a request of the form name=value asks for. 0 for success; 1 for failure, for an unknown name (compared
    /// exactly) and for a request without "=".
    unsigned int executeCIMServiceConfig(std::string& request);

private:
    struct Setting;
    static const Setting interval;
    static const Setting attempts;

    std::string commandDirectory() const;
    unsigned int set(const TracePoint& at, const Setting& setting, const std::string& value);
    bool get(const TracePoint& at, const Setting& setting, unsigned int& value) const;

    HostName hostName;
};

} // namespace VK::BaseServerProvider
