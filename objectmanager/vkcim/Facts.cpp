#include "objectmanager/vkcim/Facts.h"

#include "objectmanager/model/DateTime.h"
#include "objectmanager/model/TypeNames.h"

#include <fmt/format.h>

#include <string_view>

namespace vkcim {
namespace {

constexpr const char* computerClass = "VESKA_ComputerSystem";
constexpr const char* chassisClass = "VESKA_PhysicalPackage";
constexpr const char* timeServiceClass = "VESKA_TimeService";

using Elements = std::vector<om::Value>;

bool isKnownText(const om::Value& value) {
    const auto* text = std::get_if<std::string>(&value.data);
    return text == nullptr || (!text->empty() && *text != unknownWord);
}

/// What is known of a value, perhaps null.
om::Value knownPart(const om::NamedValue& property, const std::string& className, const om::Schema& schema) {
    const std::vector<std::string_view> words = schema.wordsFor(className, property);
    const auto* elements = std::get_if<Elements>(&property.second.data);
    if (elements == nullptr) {
        const bool known = isKnownText(property.second) && (words.empty() || words.front() != unknownWord);
        return known ? property.second : om::Value{property.second.type, {}};
    }
    Elements known;
    for (std::size_t i = 0; i < elements->size(); ++i) {
        const om::Value& each = (*elements)[i];
        if (!each.isNull() && isKnownText(each) && (words.empty() || words[i] != unknownWord)) known.push_back(each);
    }
    om::Value part{property.second.type, {}};
    if (!known.empty()) part.data = std::move(known);
    return part;
}

/// The texts of the one say what those of the other at the same place are: with one of them both go.
void dropUnknownIdentifiers(std::vector<om::NamedValue>& properties) {
    const auto find = [&](const char* name) -> Elements* {
        for (auto& [each, value] : properties)
            if (om::sameName(each, name)) return std::get_if<Elements>(&value.data);
        return nullptr;
    };
    Elements* identifiers = find("OtherIdentifyingInfo");
    Elements* descriptions = find("IdentifyingDescriptions");
    if (identifiers == nullptr || descriptions == nullptr || identifiers->size() != descriptions->size()) return;
    for (std::size_t i = identifiers->size(); i-- > 0;) {
        const om::Value& identifier = (*identifiers)[i];
        if (!identifier.isNull() && isKnownText(identifier)) continue;
        identifiers->erase(identifiers->begin() + static_cast<std::ptrdiff_t>(i));
        descriptions->erase(descriptions->begin() + static_cast<std::ptrdiff_t>(i));
    }
}

om::Instance whatIsKnown(om::Instance instance, const om::Schema& schema) {
    dropUnknownIdentifiers(instance.properties);
    std::vector<om::NamedValue> known;
    for (const om::NamedValue& each : instance.properties) {
        if (namesClass(each.first)) continue;
        om::Value part = knownPart(each, instance.path.className, schema);
        if (!part.isNull()) known.emplace_back(each.first, std::move(part));
    }
    instance.properties = std::move(known);
    return instance;
}

std::vector<om::Instance> instancesOf(const std::string& className, const Report& report, const om::Schema& schema) {
    std::vector<om::Instance> instances;
    for (const auto& [name, answer] : report.classes) {
        if (name != className) continue;
        for (const auto& result : answer.results)
            if (const auto* instance = std::get_if<om::Instance>(&result))
                instances.push_back(whatIsKnown(*instance, schema));
    }
    return instances;
}

/// The name of the first computer. That of a report stands for one that has none, too.
std::optional<std::string> hostOf(const std::vector<om::Instance>& computers) {
    const om::Value* name = computers.empty() ? nullptr : om::findValue(computers.front().path.keys, "Name");
    const auto* known = name != nullptr && isKnownText(*name) ? std::get_if<std::string>(&name->data) : nullptr;
    return known != nullptr ? std::optional(*known) : std::nullopt;
}

/// What is known of a clock: the file of a simulated host may hold any text as the time.
HostClock whatIsKnown(HostClock clock) {
    if (clock.time && (om::isInterval(*clock.time) || !om::microseconds(*clock.time))) clock.time.reset();
    return clock;
}

/// A class that is answered with an error would look like one of which the host has nothing.
std::vector<std::string> errorNotes(const Report& report) {
    std::vector<std::string> notes;
    for (const auto& [name, answer] : report.classes)
        if (answer.code != CMPI_RC_OK)
            notes.push_back(fmt::format("no {}: {} ({})", name, om::statusName(answer.code), int{answer.code}));
    return notes;
}

} // namespace

Facts gatherFacts(const om::Schema& schema, const std::string& nameSpace,
                  const std::optional<std::vector<std::string>>& properties,
                  const std::function<om::Answer(const om::Request&)>& run, const std::function<HostClock()>& clock,
                  const std::function<std::vector<std::string>()>& notes) {
    const Subjects subjects = {{computerClass, chassisClass, timeServiceClass}, {}};
    Facts facts;
    const Report report = makeReport(subjects, nameSpace, properties, run, [&] {
        facts.clock = whatIsKnown(clock());
        return notes();
    });
    facts.computers = instancesOf(computerClass, report, schema);
    facts.chassis = instancesOf(chassisClass, report, schema);
    facts.timeServices = instancesOf(timeServiceClass, report, schema);
    facts.host = hostOf(facts.computers);
    facts.notes = errorNotes(report);
    facts.notes.insert(facts.notes.end(), report.notes.begin(), report.notes.end());
    facts.version = report.version;
    facts.time = report.time;
    return facts;
}

} // namespace vkcim
