#include "objectmanager/vkcim/TextOutput.h"

#include "objectmanager/vkcim/LinkTree.h"
#include "objectmanager/vkcim/Names.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/Utf8.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

#include <algorithm>

namespace vkcim {
namespace {

std::string heading(const std::string& text, const TextStyle& style) {
    return style.colours ? "\x1b[1m" + text + "\x1b[0m" : text;
}

std::string faint(const std::string& text, const TextStyle& style) {
    return style.colours ? "\x1b[2m" + text + "\x1b[0m" : text;
}

std::string table(const std::vector<om::NamedValue>& values, const TextStyle& style) {
    std::size_t width = 0;
    for (const om::NamedValue& value : values) width = std::max(width, printable(value.first).size());
    std::string text;
    for (const auto& [name, value] : values) {
        const std::string shown = printable(plainText(value, {style.nameSpace, style.schema}));
        // An empty text would look like a value that is missing from the table.
        text += fmt::format("  {:<{}}  {}\n", printable(name), width,
                            shown.empty() && !value.isNull() && !isArray(value.type) ? faint("(empty)", style) : shown);
    }
    return text;
}

std::string pathLine(const om::ObjectPath& path, const TextStyle& style) {
    return printable(qualifiedPathText(path, style.nameSpace, style.schema));
}

std::string results(const om::Answer& answer, const TextStyle& style) {
    std::string text;
    for (const auto& result : answer.results) {
        if (const auto* path = std::get_if<om::ObjectPath>(&result)) {
            text += pathLine(*path, style) + '\n';
            continue;
        }
        const auto& instance = std::get<om::Instance>(result);
        if (!text.empty()) text += '\n';
        text += heading(pathLine(instance.path, style), style) + '\n' + table(instance.properties, style);
    }
    return text;
}

std::string group(const std::string& className, const om::Answer& answer, const TextStyle& style) {
    const std::string status = statusName(static_cast<int>(answer.code));
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
    std::vector<om::NamedValue> returned;
    if (answer.returnValue) returned.emplace_back("return value", *answer.returnValue);
    returned.insert(returned.end(), answer.out.begin(), answer.out.end());
    if (!returned.empty()) text += table(returned, style);
    if (text.empty() && answer.code == CMPI_RC_OK) text = faint("(nothing returned)", style) + '\n';
    return text;
}

std::string plainReport(const Report& report, const TextStyle& style) {
    std::string text = heading(fmt::format("Host {}", printable(report.host)), style) + "  " +
                       faint(printable(style.nameSpace), style) + '\n';
    for (const auto& [className, answer] : report.classes) text += '\n' + group(className, answer, style);
    text += '\n' + heading("Associations", style) + '\n';
    const std::vector<Link> drawn = links(report.associations, style.nameSpace, style.schema);
    for (const std::string& line : drawLinks(drawn)) text += "  " + printable(line) + '\n';
    for (const auto& [className, answer] : report.associations) {
        if (answer.code == CMPI_RC_OK && !answer.results.empty()) continue;
        text += "  " + group(className, answer, style);
    }
    if (!report.notes.empty()) text += '\n' + heading("Notes", style) + '\n';
    for (const std::string& note : report.notes) text += "  - " + printable(note) + '\n';
    return text;
}

} // namespace vkcim
