#include "provider/LogEvents.h"

#include "support/SimulatedHost.h"

#include <regex>
#include <stdexcept>

namespace test {
namespace {

const std::string rule(78, '=');

std::string line(const std::string& word, const std::string& function) {
    return word + ": " + function + "() in BaseServerProvider [Line]";
}

} // namespace

std::vector<std::string> events(const std::vector<std::string>& lines) {
    static const std::regex address("0x[0-9a-f]+");
    static const std::regex lineInMessage(", Line: [0-9]+\\]");
    static const std::string log = "LOG ";
    static const std::string trace = "TRACE ";
    static const std::string category = " Norvane.BaseServerProvider";
    const std::vector<std::string> cut = withoutPlaces(lines);
    std::vector<std::string> found;
    for (std::size_t i = 0; i < cut.size(); i += 2) {
        const bool inBoth = cut[i].rfind(log, 0) == 0 && i + 1 < cut.size() && cut[i + 1].rfind(trace, 0) == 0 &&
                            cut[i].substr(log.size()) == cut[i + 1].substr(trace.size());
        const std::size_t at = cut[i].find(category);
        if (!inBoth || at == std::string::npos) throw std::runtime_error("not in both channels: " + lines[i]);
        std::string text = cut[i].substr(log.size());
        text.erase(at - log.size(), category.size());
        found.push_back(std::regex_replace(std::regex_replace(text, address, "ADDRESS"), lineInMessage, ", Line: N]"));
    }
    return found;
}

std::string event(int level, const std::string& file, const std::string& function, const std::string& text) {
    return std::to_string(level) + " " + file + " " + function + ": " + text;
}

std::string method(const std::string& file, const std::string& function) {
    return event(4000, file, function, "METHOD: " + function + "() was invoked in " + file + " [Line]");
}

std::string variable(const std::string& file, const std::string& function, const std::string& name,
                     const std::string& value) {
    return event(4000, file, function, "VARIABLE: '" + name + "' has Value '" + value + "' [Line] in " + file);
}

std::vector<std::string> entryMarker(const std::string& operation) {
    return {event(4000, "Trace", "markProviderEntry", rule),
            event(4000, "Trace", "markProviderEntry", line("ENTERING", operation))};
}

std::vector<std::string> exitMarker(const std::string& operation) {
    return {event(4000, "Trace", "markProviderExit", line("EXITING", operation)),
            event(4000, "Trace", "markProviderExit", rule)};
}

} // namespace test
