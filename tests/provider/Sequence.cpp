#include "provider/Sequence.h"

#include "nvlog/NVLogger.h"
#include "provider/LogEvents.h"
#include "support/NoCommands.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <algorithm>

namespace test {
namespace {

constexpr char brokerFile[] = "Broker";
constexpr char called[] = "called";
constexpr char category[] = "Norvane.BaseServerProvider";

/// The platform's libraries write to the log channel alone.
bool isOfALibrary(const std::string& line) {
    return line.find(std::string(" ") + category + " ") == std::string::npos;
}

/// Writes an event of its own into the log, as the provider writes its lines.
void write(const char* file, const std::string& function, const std::string& text) {
    NVLog::NVLogger::logLevelMessage(function.c_str(), file, 1, category, 4000, nullptr, 0, 0, text);
    NVLog::NVLogger::traceLevelMessage(function.c_str(), file, 1, category, 4000, nullptr, 0, 0, text);
}

} // namespace

std::vector<std::string> sequence(const om::Request& request) {
    om::Request watched = request;
    watched.onCall = [](const std::string& slot) { write(brokerFile, slot, called); };
    om::ObjectManager& manager = provider(); // loaded before the log is looked at
    takeLog();
    tellCommands([](const std::string& function, const std::string& asked) { write("Shell", function, asked); });
    manager.run(watched);
    tellCommands({});
    std::vector<std::string> lines = takeLog();
    lines.erase(std::remove_if(lines.begin(), lines.end(), isOfALibrary), lines.end());
    return events(lines);
}

std::string brokerCall(const std::string& slot) {
    return event(4000, brokerFile, slot, called);
}

} // namespace test
