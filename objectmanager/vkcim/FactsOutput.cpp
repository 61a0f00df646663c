#include "objectmanager/vkcim/FactsOutput.h"

#include "objectmanager/model/NumberText.h"
#include "objectmanager/vkcim/JsonOutput.h"

namespace vkcim {
namespace {

using Elements = std::vector<om::Value>;

/// Collects the members of a JSON object.
class Members {
public:
    Members(const std::string& requestNameSpace, const om::Schema& knownClasses)
        : nameSpace(requestNameSpace), schema(knownClasses) {}

    void add(const std::string& name, const std::string& json) {
        object += (object.empty() ? "" : ",") + jsonString(name) + ':' + json;
    }
    void addText(const std::string& name, std::string_view text) { add(name, jsonString(text)); }

    void addTexts(const std::string& name, const std::vector<std::string>& texts) { add(name, jsonStrings(texts)); }

    /// Every property, and the words of those that have some.
    void add(const std::string& prefix, const om::Instance& instance) {
        for (const om::NamedValue& property : instance.properties) {
            const std::string name = prefix + '_' + property.first;
            add(name, jsonText(property.second, nameSpace, schema));
            const std::vector<std::string_view> words = schema.wordsFor(instance.path.className, property);
            if (words.empty()) continue;
            if (const auto* elements = std::get_if<Elements>(&property.second.data))
                addTexts(name + "_words", wordsOrNumbers(words, *elements));
            else
                addText(name + "_word", words.front());
        }
    }

    /// The first one without a number, as most hosts have no second.
    void addAll(const std::string& prefix, const std::vector<om::Instance>& instances) {
        for (std::size_t i = 0; i < instances.size(); ++i)
            add(i == 0 ? prefix : prefix + std::to_string(i + 1), instances[i]);
    }

    std::string text() const { return '{' + object + '}'; }

private:
    static std::vector<std::string> wordsOrNumbers(const std::vector<std::string_view>& words,
                                                   const Elements& elements) {
        std::vector<std::string> texts;
        for (std::size_t i = 0; i < words.size(); ++i)
            texts.push_back(words[i].empty() ? om::numberText(elements[i]) : std::string(words[i]));
        return texts;
    }

    const std::string& nameSpace;
    const om::Schema& schema;
    std::string object;
};

/// The word for the first computer's health.
std::string_view healthOf(const Facts& facts, const om::Schema& schema) {
    if (facts.computers.empty()) return {};
    const om::Instance& computer = facts.computers.front();
    const om::Value* health = om::findValue(computer.properties, "HealthState");
    if (health == nullptr) return {};
    const std::vector<std::string_view> words = schema.wordsFor(computer.path.className, {"HealthState", *health});
    return words.empty() ? std::string_view() : words.front();
}

} // namespace

std::string factsText(const Facts& facts, const std::string& nameSpace, const om::Schema& schema) {
    Members members(nameSpace, schema);
    if (facts.host) members.addText("host", *facts.host);
    members.addText("version", facts.version);
    members.addText("time", utcText(facts.time));
    if (const std::string_view health = healthOf(facts, schema); !health.empty()) members.addText("health", health);
    members.addAll("computer", facts.computers);
    members.addAll("chassis", facts.chassis);
    members.addAll("time_service", facts.timeServices);
    if (facts.clock.time) members.addText("time_service_time", *facts.clock.time);
    if (facts.clock.aheadMinutes) members.add("time_service_offset_minutes", *facts.clock.aheadMinutes);
    members.addTexts("notes", facts.notes);
    return members.text();
}

} // namespace vkcim
