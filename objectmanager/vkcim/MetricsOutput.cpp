#include "objectmanager/vkcim/MetricsOutput.h"

#include "objectmanager/model/NumberText.h"
#include "objectmanager/vkcim/Utf8.h"

#include <algorithm>
#include <set>

namespace vkcim {
namespace {

using Label = std::pair<std::string, std::string>;

std::string escaped(std::string_view text) {
    std::string result;
    for (const char c : cleanUtf8(text)) {
        if (c == '\n') {
            result += "\\n";
            continue;
        }
        if (c == '\\' || c == '"') result += '\\';
        result += c;
    }
    return result;
}

std::string sample(const std::string& name, const std::vector<Label>& labels, const std::string& value) {
    std::string text;
    for (const auto& [label, content] : labels)
        text += (text.empty() ? "" : ",") + label + "=\"" + escaped(content) + '"';
    return name + (text.empty() ? "" : '{' + text + '}') + ' ' + value + '\n';
}

/// The samples of one name behind what says what they are; nothing without samples.
std::string family(const std::string& name, const std::string& help, const std::string& samples) {
    if (samples.empty()) return {};
    return "# HELP " + name + ' ' + help + "\n# TYPE " + name + " gauge\n" + samples;
}

const om::Value* valueIn(const std::vector<om::Instance>& instances, const char* property) {
    return instances.empty() ? nullptr : om::findValue(instances.front().properties, property);
}

/// One sample for each state that the schema names: 1 for those that the property has. The label is named as the
/// metric, as in OpenMetrics' state sets.
std::string stateSet(const std::string& name, const std::string& help, const Facts& facts, const char* property,
                     const om::Schema& schema) {
    const om::Value* value = valueIn(facts.computers, property);
    if (value == nullptr) return {};
    const std::string& className = facts.computers.front().path.className;
    const om::PropertyDeclaration* declared = schema.findProperty(className, property);
    if (declared == nullptr) return {};
    const std::vector<std::string_view> states = schema.wordsFor(className, {property, *value});
    if (std::all_of(states.begin(), states.end(), [](std::string_view word) { return word.empty(); })) return {};
    std::string samples;
    for (const std::string_view word : om::textsOf(declared->qualifiers, "Values")) {
        if (word == unknownWord) continue; // who is in it has no such metric
        const bool applies = std::find(states.begin(), states.end(), word) != states.end();
        samples += sample(name, {{name, std::string(word)}}, applies ? "1" : "0");
    }
    return family(name, help, samples);
}

void addLabel(std::vector<Label>& labels, const char* name, const om::Instance& instance, const char* property,
              const om::Schema& schema) {
    const om::Value* value = om::findValue(instance.properties, property);
    if (value == nullptr) return;
    const std::vector<std::string_view> words = schema.wordsFor(instance.path.className, {property, *value});
    if (!words.empty() && !words.front().empty())
        labels.emplace_back(name, words.front());
    else if (const auto* text = std::get_if<std::string>(&value->data))
        labels.emplace_back(name, *text);
    else
        labels.emplace_back(name, om::numberText(*value));
}

std::string chassisInfo(const Facts& facts, const om::Schema& schema, bool withSerials) {
    const std::string name = "vk_chassis_info";
    std::string samples;
    for (std::size_t i = 0; i < facts.chassis.size(); ++i) {
        // Two alike would be the same series twice, which refuses the whole text.
        std::vector<Label> labels = {{"chassis", std::to_string(i + 1)}};
        addLabel(labels, "manufacturer", facts.chassis[i], "Manufacturer", schema);
        addLabel(labels, "model", facts.chassis[i], "Model", schema);
        addLabel(labels, "type", facts.chassis[i], "PackageType", schema);
        if (withSerials) addLabel(labels, "serial", facts.chassis[i], "SerialNumber", schema);
        samples += sample(name, labels, "1");
    }
    return family(name, "What each chassis is, always 1.", samples);
}

std::string dstAdjustment(const Facts& facts) {
    const std::string name = "vk_dst_adjustment";
    const om::Value* value = valueIn(facts.timeServices, "AutomaticDSTAdjustment");
    const bool* on = value != nullptr ? std::get_if<bool>(&value->data) : nullptr;
    return on == nullptr
               ? std::string()
               : family(name, "Whether local time follows daylight saving.", sample(name, {}, *on ? "1" : "0"));
}

std::string timeOffset(const Facts& facts) {
    const std::string name = "vk_time_offset_minutes";
    const std::optional<std::string>& minutes = facts.clock.aheadMinutes;
    return minutes ? family(name, "Minutes that local time is ahead of UTC.", sample(name, {}, *minutes))
                   : std::string();
}

std::string missingSources(const Facts& facts) {
    const std::string name = "vk_source_missing";
    std::set<std::string> missing;
    for (const std::string& note : facts.notes)
        if (const std::optional<std::string> source = missingSource(note))
            missing.insert(cleanUtf8(*source)); // the same series twice refuses the whole text
    std::string samples;
    for (const std::string& source : missing) samples += sample(name, {{"source", source}}, "1");
    return family(name, "What the host does not say of itself, or says with a fault, always 1.", samples);
}

std::string timestamp(const Facts& facts) {
    const std::string name = "vk_report_timestamp_seconds";
    return family(name, "When this was made, in seconds since 1970.", sample(name, {}, std::to_string(facts.time)));
}

} // namespace

std::optional<std::string> missingSource(const std::string& note) {
    constexpr std::string_view missing = "no ";
    const std::string subject = note.substr(0, note.find(": "));
    if (subject == note || subject == "time service") return std::nullopt;
    if (subject.compare(0, missing.size(), missing) != 0) return subject;
    const bool isCommand = subject.find('/') != std::string::npos;
    return isCommand ? std::nullopt : std::optional(subject.substr(missing.size()));
}

std::string metricsText(const Facts& facts, const om::Schema& schema, bool withSerials) {
    return stateSet("vk_computer_health", "Health of the computer: 1 for the state that it is in.", facts,
                    "HealthState", schema) +
           stateSet("vk_computer_operational_status", "Operational states of the computer: 1 for each that it is in.",
                    facts, "OperationalStatus", schema) +
           stateSet("vk_computer_enabled_state", "Whether the computer runs: 1 for the state that it is in.", facts,
                    "EnabledState", schema) +
           chassisInfo(facts, schema, withSerials) + timeOffset(facts) + dstAdjustment(facts) + missingSources(facts) +
           timestamp(facts) + "# EOF\n";
}

} // namespace vkcim
