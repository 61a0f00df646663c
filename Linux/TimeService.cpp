#include "Linux/TimeService.h"

#include "Linux/CommandStream.h"
#include "vk/DateTime.h"

#include <cstring>

namespace VK::BaseServerProvider {

static const std::string& loggerTimeService = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerTimeService, "TimeService"};

namespace {

constexpr unsigned int success = 0;
constexpr unsigned int failure = 2;

constexpr unsigned int cimFormat = 3;

bool contains(const std::string& text, const char* word) {
    return text.find(word) != std::string::npos;
}

} // namespace

TimeService::TimeService() : name("TimeService") {
    const TraceScope scope(VK_SCOPE(source));
    name += "@" + hostName.text();
    instrumentation.selectNode(NodeLexicon::ComputerSystemNode);
}

TimeService::~TimeService() noexcept(false) {
    const DestructorTraceScope scope(VK_SCOPE(source));
}

bool TimeService::getName(std::string& nameOut) const {
    const TraceScope scope(VK_SCOPE(source));
    nameOut = name;
    return true;
}

bool TimeService::getCreationClassName(std::string& className) const {
    const TraceScope scope(VK_SCOPE(source));
    className = "VESKA_TimeService";
    return true;
}

bool TimeService::getSystemName(std::string& nameOut) const {
    const TraceScope scope(VK_SCOPE(source));
    nameOut = hostName.text();
    return true;
}

bool TimeService::getSystemCreationClassName(std::string& className) const {
    const TraceScope scope(VK_SCOPE(source));
    className = "VESKA_ComputerSystem";
    return true;
}

bool TimeService::getAutomaticDSTAdjustment(bool& automatic) const {
    const TraceScope scope(VK_SCOPE(source));
    unsigned int value{};
    const bool known = instrumentation.getProperty(NodeLexicon::AutomaticDSTAdjustmentProperty, value);
    automatic = known && value != 0;
    return known;
}

bool TimeService::setAutomaticDSTAdjustment(bool automatic) {
    const TraceScope scope(VK_SCOPE(source));
    unsigned int value = automatic ? 1 : 0;
    return instrumentation.setProperty(NodeLexicon::AutomaticDSTAdjustmentProperty, value);
}

bool TimeService::executeCommand(const char* command, const char* mode, std::string& output) {
    const TraceScope scope(VK_SCOPE(source));
    CommandStream stream(command, mode);
    if (!stream) return false;
    std::memset(commandOutput, 0, sizeof commandOutput);
    output.clear();
    if (stream.readLine(commandOutput, sizeof commandOutput)) output = commandOutput;
    return true;
}

bool TimeService::isDaemonRunning() {
    std::string output;
    return executeCommand("ps -ef|grep -i \"ntpd\"|grep -v grep", "r", output) && !output.empty();
}

unsigned int TimeService::runInitScript(const char* command) {
    std::string output;
    return executeCommand(command, "r", output) && contains(output, "done") ? success : failure;
}

unsigned int TimeService::StartService() {
    const TraceScope scope(VK_SCOPE(source));
    return isDaemonRunning() ? success : runInitScript("/etc/init.d/ntp start");
}

unsigned int TimeService::StopService() {
    const TraceScope scope(VK_SCOPE(source));
    return isDaemonRunning() ? runInitScript("/etc/init.d/ntp stop") : success;
}

unsigned int TimeService::SyncClock() {
    const TraceScope scope(VK_SCOPE(source));
    const bool wasRunning = isDaemonRunning();
    if (wasRunning) StopService(); // on purpose: its result is ignored
    std::string output;
    const bool synchronised = executeCommand("ntpd -xgq", "r", output) &&
                              (contains(output, "ntpd: time slew") || contains(output, "ntpd: time set"));
    // On purpose: the restart's result replaces that of the synchronisation.
    if (wasRunning) return StartService();
    return synchronised ? success : failure;
}

unsigned int TimeService::manageTime(long& time, unsigned int& gmtOffset) {
    const TraceScope scope(VK_SCOPE(source));
    std::string timeText = DateTime(time, cimFormat);
    if (!instrumentation.setProperty(NodeLexicon::GmtOffsetProperty, gmtOffset)) {
        traceMessage(source, "setProperty::timezone failed!!", NoticeLevel);
        return failure;
    }
    if (!instrumentation.setProperty(NodeLexicon::SystemTimeProperty, timeText)) {
        traceMessage(source, "setProperty::Time failed!!", NoticeLevel);
        return failure;
    }
    return SyncClock();
}

} // namespace VK::BaseServerProvider
