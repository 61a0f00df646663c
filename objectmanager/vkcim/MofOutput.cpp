#include "objectmanager/vkcim/MofOutput.h"

#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/Utf8.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

#include <cmath>

namespace vkcim {
namespace {

std::string inQuotes(std::string_view text) {
    std::string literal = "\"";
    for (const char c : cleanUtf8(text)) {
        const auto byte = static_cast<unsigned char>(c);
        switch (c) {
        case '"':
        case '\\':
            literal += '\\';
            literal += c;
            break;
        case '\n':
            literal += "\\n";
            break;
        case '\t':
            literal += "\\t";
            break;
        case '\r':
            literal += "\\r";
            break;
        default:
            // Four digits, so that a digit that follows is not taken into the escape.
            literal += byte < 0x20 || byte == 0x7f ? fmt::format("\\x{:04X}", byte) : std::string(1, c);
        }
    }
    return literal + '"';
}

/// MOF knows no literal for NaN and the infinities: they become NULL with a comment.
std::string realLiteral(const om::Value& value, double number) {
    std::string text = om::numberText(value);
    if (!std::isfinite(number)) return "NULL /* " + text + " */";
    if (text.find('.') != std::string::npos) return text;
    // A point is required, also before an exponent.
    const std::size_t exponent = text.find('e');
    return text.insert(exponent == std::string::npos ? text.size() : exponent, ".0");
}

class MofWriter {
public:
    MofWriter(const std::string& requestNameSpace, const om::Schema& knownClasses)
        : nameSpace(requestNameSpace), schema(knownClasses) {}

    std::string answer(const om::Answer& answer) const {
        std::string text;
        for (const auto& each : answer.results) {
            const auto* path = std::get_if<om::ObjectPath>(&each);
            text +=
                path ? printable(qualifiedPathText(*path, nameSpace, schema)) : instance(std::get<om::Instance>(each));
            text += '\n';
        }
        const ValueContext context{nameSpace, schema};
        if (answer.returnValue) text += "// return value " + printable(valueText(*answer.returnValue, context)) + '\n';
        for (const auto& [name, value] : answer.out) {
            text += "// out " + printable(name + '=' + valueText(value, context)) + '\n';
        }
        return text;
    }

    std::string report(const Report& report) const {
        std::string text = "// Host " + printable(report.host) + "\n";
        for (const Report::Answers* group : {&report.classes, &report.associations}) {
            for (const auto& [name, each] : *group) {
                text += fmt::format("\n// {}: {}\n", name, om::statusName(static_cast<int>(each.code)));
                text += answer(each);
            }
        }
        if (!report.notes.empty()) text += "\n// Notes\n";
        for (const std::string& note : report.notes) text += "// - " + printable(note) + '\n';
        return text;
    }

private:
    std::string instance(const om::Instance& instance) const {
        std::string text = fmt::format("instance of {} {{\n", printable(instance.path.className));
        for (const auto& [name, value] : instance.properties) {
            text += fmt::format("    {} = {};\n", printable(name), literal(value));
        }
        return text + "};";
    }

    std::string literal(const om::Value& value) const {
        if (value.isNull()) return "NULL";
        if (const auto* flag = std::get_if<bool>(&value.data)) return *flag ? "TRUE" : "FALSE";
        if (const auto* real = std::get_if<double>(&value.data)) return realLiteral(value, *real);
        if (const auto* elements = std::get_if<std::vector<om::Value>>(&value.data)) {
            std::string list;
            for (const om::Value& element : *elements) list += (list.empty() ? "" : ", ") + literal(element);
            return '{' + list + '}';
        }
        if (const auto* embedded = std::get_if<std::shared_ptr<const om::Instance>>(&value.data)) {
            return *embedded ? inQuotes(instance(**embedded)) : "NULL";
        }
        std::string number = om::numberText(value);
        if (!number.empty()) return number;
        return inQuotes(plainText(value, {nameSpace, schema}));
    }

    const std::string& nameSpace;
    const om::Schema& schema;
};

} // namespace

std::string mofText(const om::Answer& answer, const std::string& nameSpace, const om::Schema& schema) {
    return MofWriter(nameSpace, schema).answer(answer);
}

std::string mofText(const Report& report, const std::string& nameSpace, const om::Schema& schema) {
    return MofWriter(nameSpace, schema).report(report);
}

} // namespace vkcim
