#include "objectmanager/vkcim/TextOutput.h"

#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/LinkTree.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/Utf8.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

#include <algorithm>

namespace vkcim {
namespace {

std::string heading(const std::string& text, const TextStyle& style) {
    return style.look.colours ? "\x1b[1m" + text + "\x1b[0m" : text;
}

std::string faint(const std::string& text, const TextStyle& style) {
    return style.look.colours ? "\x1b[2m" + text + "\x1b[0m" : text;
}

// The texts of the second say what those of the first at the same place are.
constexpr const char* identifiers = "OtherIdentifyingInfo";
constexpr const char* descriptions = "IdentifyingDescriptions";

using Words = std::vector<std::string_view>;
using Elements = std::vector<om::Value>;

/// The descriptions of an instance's identifiers, as many as there are of these; else none.
Words descriptionsOf(const om::Instance& instance) {
    const om::Value* described = om::findValue(instance.properties, identifiers);
    const om::Value* by = om::findValue(instance.properties, descriptions);
    const auto* elements = described != nullptr ? std::get_if<Elements>(&described->data) : nullptr;
    const auto* texts = by != nullptr ? std::get_if<Elements>(&by->data) : nullptr;
    Words words;
    if (elements == nullptr || texts == nullptr || elements->size() != texts->size()) return words;
    for (const om::Value& each : *texts)
        if (const auto* text = std::get_if<std::string>(&each.data)) words.push_back(*text);
    return words.size() == elements->size() ? words : Words();
}

std::string withWord(const om::Value& value, std::string_view word, const TextStyle& style) {
    const std::string text = printable(plainText(value, {style.nameSpace, style.schema}));
    return word.empty() ? text : text + " (" + printable(word) + ')';
}

/// A value with a word behind each of its elements.
std::string withWords(const om::Value& value, const Words& words, const std::string& separator,
                      const TextStyle& style) {
    const auto* elements = std::get_if<Elements>(&value.data);
    if (elements == nullptr || words.size() != elements->size())
        return withWord(value, words.empty() ? std::string_view() : words.front(), style);
    std::string text;
    for (std::size_t i = 0; i < words.size(); ++i)
        text += (i == 0 ? "" : separator) + withWord((*elements)[i], words[i], style);
    return text;
}

/// A row's name and text, of one line or several.
using Row = std::pair<std::string, std::string>;

std::string rowText(const om::NamedValue& each, const Words& words, const TextStyle& style) {
    const std::string text = withWords(each.second, words, ", ", style);
    // An empty text would look like a value that is missing from the table.
    return text.empty() && !each.second.isNull() && !om::isArray(each.second.type) ? faint("(empty)", style) : text;
}

std::string table(const std::vector<Row>& rows, const TextStyle& style) {
    std::size_t width = 0;
    for (const Row& row : rows) width = std::max(width, row.first.size());
    std::string text;
    for (const auto& [name, shown] : rows) {
        std::string_view rest = shown;
        for (std::string_view head = name;; head = "") {
            const std::size_t end = std::min(rest.find('\n'), rest.size());
            text += wrapped(fmt::format("  {:<{}}  {}\n", head, width, rest.substr(0, end)), style.look.width);
            if (end == rest.size()) break;
            rest.remove_prefix(end + 1);
        }
    }
    return text;
}

std::vector<Row> rowsOf(const om::Instance& instance, const TextStyle& style) {
    const Words described = descriptionsOf(instance);
    std::vector<Row> rows;
    for (const om::NamedValue& each : instance.properties) {
        if (!described.empty() && om::sameName(each.first, descriptions)) continue;
        const bool isDescribed = !described.empty() && om::sameName(each.first, identifiers);
        rows.emplace_back(printable(each.first),
                          isDescribed ? withWords(each.second, described, "\n", style)
                                      : rowText(each, style.schema.wordsFor(instance.path.className, each), style));
    }
    return rows;
}

std::string pathLine(const om::ObjectPath& path, const TextStyle& style) {
    return printable(qualifiedPathText(path, style.nameSpace, style.schema));
}

/// Lists of paths stay unbroken, as they are given back to commands.
std::string results(const om::Answer& answer, const TextStyle& style) {
    std::string text;
    for (const auto& result : answer.results) {
        if (const auto* path = std::get_if<om::ObjectPath>(&result)) {
            text += pathLine(*path, style) + '\n';
            continue;
        }
        const auto& instance = std::get<om::Instance>(result);
        if (!text.empty()) text += '\n';
        text += wrapped(heading(pathLine(instance.path, style), style) + '\n', style.look.width) +
                table(rowsOf(instance, style), style);
    }
    return text;
}

std::string group(const std::string& className, const om::Answer& answer, const TextStyle& style) {
    const std::string status = om::statusName(static_cast<int>(answer.code));
    if (answer.code == CMPI_RC_ERR_INVALID_CLASS) {
        return heading(className, style) + "  " + faint("not served: " + status, style) + '\n';
    }
    if (answer.code != CMPI_RC_OK) {
        const std::string message = answer.message ? ", " + printable(*answer.message) : "";
        return fmt::format("{}  answered {} ({}){}\n", heading(className, style), status, static_cast<int>(answer.code),
                           message) +
               results(answer, style);
    }
    if (answer.results.empty()) return heading(className, style) + "  " + faint("no instance", style) + '\n';
    return results(answer, style);
}

} // namespace

std::string plainAnswer(const om::Answer& answer, const TextStyle& style) {
    std::string text = results(answer, style);
    std::vector<Row> returned;
    const auto add = [&](const std::string& name, const om::Value& value) {
        returned.emplace_back(printable(name), rowText({name, value}, {}, style));
    };
    if (answer.returnValue) add("return value", *answer.returnValue);
    for (const auto& [name, value] : answer.out) add(name, value);
    text += table(returned, style);
    if (text.empty() && answer.code == CMPI_RC_OK) text = faint("(nothing returned)", style) + '\n';
    return text;
}

std::string plainReport(const Report& report, const TextStyle& style) {
    std::string text = heading(fmt::format("Host {}", printable(report.host)), style) + "  " +
                       faint(printable(style.nameSpace), style) + '\n';
    for (const auto& [className, answer] : report.classes) text += '\n' + group(className, answer, style);
    text += '\n' + heading("Associations", style) + '\n';
    Look tree = style.look;
    if (tree.width > 2) tree.width -= 2;
    for (const std::string& line : drawLinks(links(report.associations, style.nameSpace, style.schema), tree))
        text += "  " + line + '\n';
    for (const auto& [className, answer] : report.associations) {
        if (answer.code == CMPI_RC_OK && !answer.results.empty()) continue;
        text += "  " + group(className, answer, style);
    }
    if (!report.notes.empty()) text += '\n' + heading("Notes", style) + '\n';
    for (const std::string& note : report.notes) text += wrapped("  - " + printable(note) + '\n', style.look.width);
    return text;
}

std::string plainValues(const om::Answer& answer, const std::string& property, const TextStyle& style) {
    std::string text;
    for (const auto& result : answer.results) {
        const auto* instance = std::get_if<om::Instance>(&result);
        const om::Value* value = instance != nullptr ? om::findValue(instance->properties, property) : nullptr;
        if (value == nullptr) continue;
        const auto* elements = std::get_if<Elements>(&value->data);
        for (const om::Value& each : elements != nullptr ? *elements : Elements{*value})
            if (!each.isNull()) text += printable(plainText(each, {style.nameSpace, style.schema})) + '\n';
    }
    return text;
}

} // namespace vkcim
