#include "Linux/CIMServiceConfig.h"

#include "Linux/CommandStream.h"
#include "include/MachineLock.h"
#include "vk/Product.h"
#include "vk/ProviderUtilities.h"

#include <cstdlib>

namespace VK::BaseServerProvider {

static const std::string& loggerCIMServiceConfig = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerCIMServiceConfig, "CIMServiceConfig"};

namespace {

/// Two runs at once can empty the server's file of planned settings, with which it does not start again.
int runAlone(const std::string& command) {
    const MachineLock lock("vk-cimconfig.lock");
    return std::system(command.c_str()); // NOLINT(cert-env33-c): running it is what the operation is for
}

} // namespace

struct CIMServiceConfig::Setting {
    const char* argument; ///< its name in requests
    const char* setCommand;
    const char* getCommand; ///< with two blanks, on purpose
    const char* outputKey;
};

const CIMServiceConfig::Setting CIMServiceConfig::interval = {
    "deliveryRetryIntervalSec",
    "cimconfig -s minIndicationDeliveryRetryInterval=", "cimconfig  -g minIndicationDeliveryRetryInterval",
    "minIndicationDeliveryRetryInterval="};

const CIMServiceConfig::Setting CIMServiceConfig::attempts = {
    "deliveryRetryAttempts",
    "cimconfig -s maxIndicationDeliveryRetryAttempts=", "cimconfig  -g maxIndicationDeliveryRetryAttempts",
    "maxIndicationDeliveryRetryAttempts="};

CIMServiceConfig::CIMServiceConfig() {
    const TraceScope scope(VK_SCOPE(source));
}

bool CIMServiceConfig::getName(std::string& name) const {
    const TraceScope scope(VK_SCOPE(source));
    name = "VESKA_CIMServiceConfig";
    return true;
}

bool CIMServiceConfig::getCreationClassName(std::string& className) const {
    const TraceScope scope(VK_SCOPE(source));
    className = "VESKA_CIMServiceConfig";
    return true;
}

bool CIMServiceConfig::getSystemName(std::string& name) const {
    const TraceScope scope(VK_SCOPE(source));
    name = hostName.text();
    return true;
}

bool CIMServiceConfig::getSystemCreationClassName(std::string& className) const {
    const TraceScope scope(VK_SCOPE(source));
    className = "VESKA_ComputerSystem";
    return true;
}

std::string CIMServiceConfig::getbinDirectory() const {
    const TraceScope scope(VK_SCOPE(source));
    std::string directory;
    for (const wchar_t wide : Product::getRootDirectory()) directory += static_cast<char>(wide & 0xFF);
    return directory.substr(0, directory.find("platform")) + "vcm/bin/";
}

std::string CIMServiceConfig::commandDirectory() const {
    std::string directory = getbinDirectory();
    return ProviderUtilities::isKVM() ? "/usr/sbin/" : directory;
}

unsigned int CIMServiceConfig::set(const TracePoint& at, const Setting& setting, const std::string& value) {
    const std::string command = commandDirectory() + setting.setCommand + value + " -p";
    traceVariable(at, "cimconfig command :", command.c_str(), NoticeLevel);
    if (runAlone(command) != 0) {
        traceVariable(at, "command failed", command.c_str(), FailureLevel);
        return 1;
    }
    traceMessage(at, "command ran successfully", NoticeLevel);
    return 0;
}

bool CIMServiceConfig::get(const TracePoint& at, const Setting& setting, unsigned int& value) const {
    const std::string command = commandDirectory() + setting.getCommand;
    traceVariable(at, "cimconfig command :", command.c_str());
    CommandStream stream(command.c_str(), "r");
    if (!stream) return false;
    char line[256] = {};
    stream.readLine(line, sizeof line);
    traceVariable(at, "output from cimconfig command :", line);
    const std::string text = line;
    // On purpose: without a ":" the position behind it wraps to 0, and the whole line is read.
    const std::string number = text.substr(text.find(':') + 1);
    value = static_cast<unsigned int>(std::strtol(number.c_str(), nullptr, 10));
    traceVariable(at, setting.outputKey, value);
    return true;
}

unsigned int CIMServiceConfig::setIntervalParameter(std::string value) {
    const TraceScope scope(VK_SCOPE(source));
    return set(source, interval, value);
}

unsigned int CIMServiceConfig::setAttemptParameter(std::string value) {
    const TraceScope scope(VK_SCOPE(source));
    return set(source, attempts, value);
}

bool CIMServiceConfig::getIntervalParameter(unsigned int& seconds) const {
    const TraceScope scope(VK_SCOPE(source));
    return get(source, interval, seconds);
}

bool CIMServiceConfig::getAttemptParameter(unsigned int& attemptsOut) const {
    const TraceScope scope(VK_SCOPE(source));
    return get(source, attempts, attemptsOut);
}

unsigned int CIMServiceConfig::executeCIMServiceConfig(std::string& request) {
    const TraceScope scope(VK_SCOPE(source), FailureLevel); // on purpose: the entry line has this level
    const std::size_t equals = request.find('=');
    if (equals == std::string::npos) return 1;
    const std::string name = request.substr(0, equals);
    const std::string value = request.substr(equals + 1);
    traceVariable(source, "PropertyName", name.c_str());
    const bool isInterval = name == interval.argument;
    if (!isInterval && name != attempts.argument) return 1;
    traceVariable(source, "executeCIMServiceConfig CALL TO SET ", request.c_str());
    return isInterval ? setIntervalParameter(value) : setAttemptParameter(value);
}

} // namespace VK::BaseServerProvider
