#include "objectmanager/vkcim/Report.h"

#include "objectmanager/model/Names.h"
#include "objectmanager/vkcim/HostNotes.h"
#include "objectmanager/vkcim/PathText.h"

#include <algorithm>
#include <array>

namespace vkcim {
namespace {

/// Which reference of an association is drawn above the other, by the names that the standard's associations give them.
struct Direction {
    const char* above;
    const char* below;
};

constexpr Direction directions[] = {
    {"Antecedent", "Dependent"}, {"ManagedElement", "Capabilities"}, {"AffectingElement", "AffectedElement"}};

/// The name of the described host: of a snapshot or a simulated host it is not the kernel's. A provider that
/// does not serve computer systems describes no other host: there it is the kernel's.
std::string hostName(const Report::Answers& classes) {
    const auto computers = std::find_if(classes.begin(), classes.end(), [](const auto& answered) {
        return om::sameName(answered.first, "VESKA_ComputerSystem");
    });
    if (computers == classes.end() || computers->second.code != CMPI_RC_OK) return kernelsHostName();
    for (const auto& result : computers->second.results) {
        const auto* computer = std::get_if<om::Instance>(&result);
        if (!computer) continue;
        for (const auto& [name, value] : computer->path.keys) {
            const auto* text = std::get_if<std::string>(&value.data);
            if (text && om::sameName(name, "Name")) return *text;
        }
    }
    return "without a name";
}

om::ObjectPath withoutClassNames(om::ObjectPath path) {
    const auto isClass = [](const om::NamedValue& key) { return namesClass(key.first); };
    path.keys.erase(std::remove_if(path.keys.begin(), path.keys.end(), isClass), path.keys.end());
    return path;
}

std::string referenceText(const om::Instance& instance, const char* name, const std::string& nameSpace,
                          const om::Schema& schema) {
    for (const om::NamedValue& property : instance.properties) {
        if (!om::sameName(property.first, name)) continue;
        const auto* path = std::get_if<std::shared_ptr<const om::ObjectPath>>(&property.second.data);
        if (path && *path) return qualifiedPathText(withoutClassNames(**path), nameSpace, schema);
    }
    return {};
}

} // namespace

std::string utcText(std::time_t time) {
    std::tm parts{};
    gmtime_r(&time, &parts);
    std::array<char, 32> text;
    return {text.data(), std::strftime(text.data(), text.size(), "%Y-%m-%dT%H:%M:%SZ", &parts)};
}

bool namesClass(std::string_view name) {
    constexpr std::string_view end = "CreationClassName";
    return name.size() >= end.size() && om::sameName(name.substr(name.size() - end.size()), end);
}

Subjects everythingServed(const om::Schema& schema) {
    return {schema.servedClasses(), schema.servedAssociations()};
}

Report makeReport(const Subjects& subjects, const std::string& nameSpace,
                  const std::optional<std::vector<std::string>>& properties,
                  const std::function<om::Answer(const om::Request&)>& run,
                  const std::function<std::vector<std::string>()>& notes) {
    const auto ask = [&](const std::vector<std::string>& classNames) {
        Report::Answers answers;
        for (const std::string& name : classNames) {
            om::Request request;
            request.operation = om::Operation::EnumInstances;
            request.path.nameSpace = nameSpace;
            request.path.className = name;
            request.propertyList = properties;
            answers.emplace_back(name, run(request));
        }
        return answers;
    };
    Report report;
    report.classes = ask(subjects.classes);
    report.host = hostName(report.classes);
    report.associations = ask(subjects.associations);
    report.notes = notes();
    report.version = VKCIM_VERSION;
    report.time = std::time(nullptr);
    return report;
}

std::vector<Link> links(const Report::Answers& associations, const std::string& nameSpace, const om::Schema& schema) {
    std::vector<Link> found;
    for (const auto& [name, answer] : associations) {
        for (const auto& result : answer.results) {
            const auto* instance = std::get_if<om::Instance>(&result);
            if (!instance) continue;
            for (const Direction& direction : directions) {
                const Link link = {referenceText(*instance, direction.above, nameSpace, schema),
                                   referenceText(*instance, direction.below, nameSpace, schema), name};
                if (!link.above.empty() || !link.below.empty()) found.push_back(link);
            }
        }
    }
    return found;
}

} // namespace vkcim
