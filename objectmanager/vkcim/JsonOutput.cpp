#include "objectmanager/vkcim/JsonOutput.h"

#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/Utf8.h"

#include <nlohmann/json.hpp>

#include <cmath>

namespace vkcim {

std::string jsonString(std::string_view text) {
    return nlohmann::json(cleanUtf8(text)).dump();
}

namespace {

/// Writes the texts by hand rather than through a tree of JSON values: only so do integers above 2^53 and reals of 32
/// bits keep exactly the digits they should.
class JsonWriter {
public:
    JsonWriter(const std::string& requestNameSpace, const om::Schema& knownClasses)
        : nameSpace(requestNameSpace), schema(knownClasses) {}

    std::string answer(const om::Answer& answer) const {
        const std::string status = object({member("code", std::to_string(static_cast<int>(answer.code))),
                                           member("name", jsonString(om::statusName(static_cast<int>(answer.code)))),
                                           member("message", answer.message ? jsonString(*answer.message) : "null")});
        return object({member("status", status), member("done", answer.done ? "true" : "false"),
                       member("results", list(answer.results, [this](const auto& each) { return result(each); })),
                       member("returnValue", answer.returnValue ? typed(*answer.returnValue) : "null"),
                       member("out", named(answer.out))});
    }

    std::string report(const Report& report) const {
        return object({member("host", jsonString(report.host)), member("version", jsonString(report.version)),
                       member("time", jsonString(utcText(report.time))), member("classes", answers(report.classes)),
                       member("associations", answers(report.associations)),
                       member("notes", jsonStrings(report.notes))});
    }

    /// The value without its type.
    std::string bare(const om::Value& value) const {
        if (value.isNull()) return "null";
        if (const auto* flag = std::get_if<bool>(&value.data)) return *flag ? "true" : "false";
        if (const auto* text = std::get_if<std::string>(&value.data)) return jsonString(*text);
        if (const auto* path = std::get_if<std::shared_ptr<const om::ObjectPath>>(&value.data)) {
            return *path ? jsonString(qualifiedPathText(**path, nameSpace, schema)) : "null";
        }
        if (const auto* embedded = std::get_if<std::shared_ptr<const om::Instance>>(&value.data)) {
            return *embedded ? instance(**embedded) : "null";
        }
        if (const auto* elements = std::get_if<std::vector<om::Value>>(&value.data)) {
            return list(*elements, [this](const om::Value& each) { return bare(each); });
        }
        const auto* real = std::get_if<double>(&value.data);
        return real && !std::isfinite(*real) ? jsonString(om::numberText(value)) : om::numberText(value);
    }

    template <typename List, typename Text>
    static std::string list(const List& items, const Text& text) {
        return joined('[', items, ']', text);
    }

private:
    static std::string member(std::string_view name, const std::string& value) {
        return jsonString(name) + ':' + value;
    }

    template <typename List, typename Text>
    static std::string joined(char open, const List& items, char close, const Text& text) {
        std::string all(1, open);
        for (const auto& item : items) {
            if (all.size() > 1) all += ',';
            all += text(item);
        }
        return all + close;
    }
    static std::string object(const std::vector<std::string>& members) {
        return joined('{', members, '}', [](const std::string& text) { return text; });
    }

    std::string answers(const Report::Answers& all) const {
        return joined('{', all, '}', [this](const auto& each) { return member(each.first, answer(each.second)); });
    }

    std::string named(const std::vector<om::NamedValue>& values) const {
        return joined('{', values, '}', [this](const auto& each) { return member(each.first, typed(each.second)); });
    }

    std::string typed(const om::Value& value, const std::vector<std::string_view>& words = {}) const {
        std::vector<std::string> members = {member("type", jsonString(om::typeName(value.type))),
                                            member("value", bare(value))};
        if (!words.empty())
            members.push_back(member("words", list(words, [](std::string_view word) {
                                         return word.empty() ? std::string("null") : jsonString(word);
                                     })));
        return object(members);
    }

    std::string properties(const om::Instance& instance) const {
        return joined('{', instance.properties, '}', [&](const auto& each) {
            return member(each.first, typed(each.second, schema.wordsFor(instance.path.className, each)));
        });
    }

    std::string result(const std::variant<om::ObjectPath, om::Instance>& either) const {
        if (const auto* path = std::get_if<om::ObjectPath>(&either)) return element(*path, "null");
        return instance(std::get<om::Instance>(either));
    }

    std::string instance(const om::Instance& instance) const { return element(instance.path, properties(instance)); }

    std::string element(const om::ObjectPath& path, const std::string& properties) const {
        return object({member("path", jsonString(pathText(path, nameSpace, schema))),
                       member("namespace", jsonString(path.nameSpace)), member("class", jsonString(path.className)),
                       member("keys", named(path.keys)), member("properties", properties)});
    }

    const std::string& nameSpace;
    const om::Schema& schema;
};

} // namespace

std::string jsonText(const om::Answer& answer, const std::string& nameSpace, const om::Schema& schema) {
    return JsonWriter(nameSpace, schema).answer(answer);
}

std::string jsonText(const Report& report, const std::string& nameSpace, const om::Schema& schema) {
    return JsonWriter(nameSpace, schema).report(report);
}

std::string jsonText(const om::Value& value, const std::string& nameSpace, const om::Schema& schema) {
    return JsonWriter(nameSpace, schema).bare(value);
}

std::string jsonStrings(const std::vector<std::string>& texts) {
    return JsonWriter::list(texts, jsonString);
}

} // namespace vkcim
