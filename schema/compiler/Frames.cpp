#include "objectmanager/model/TypeNames.h"
#include "objectmanager/mof/ClassCheck.h"
#include "schema/compiler/Outputs.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

#include <algorithm>
#include <map>

namespace compiler {
namespace {

using fmt::format;
using Strings = std::vector<std::string>;

std::string replaced(std::string text, const std::string& from, const std::string& to) {
    for (std::size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size())) {
        text.replace(at, from.size(), to);
    }
    return text;
}

/// A text of the schema as roff shows it. A dot or an apostrophe begins no request.
std::string escaped(const std::string& text) {
    std::string shown = replaced(replaced(text, "\\", "\\e"), "-", "\\-");
    for (const char* start : {".", "'"}) {
        shown = replaced('\n' + shown, std::string("\n") + start, std::string("\n\\&") + start).substr(1);
    }
    return shown;
}

std::string description(const om::Qualifiers& qualifiers) {
    return std::string(om::textOf(qualifiers, "Description"));
}

/// What the numbers mean, unless they speak for themselves.
std::string values(const om::Qualifiers& qualifiers) {
    const auto numbers = om::textsOf(qualifiers, "ValueMap");
    const auto texts = om::textsOf(qualifiers, "Values");
    if (numbers.empty() || numbers == texts) return {};
    Strings pairs;
    for (std::size_t i = 0; i < numbers.size(); ++i) pairs.push_back(format("{} {}", numbers[i], texts[i]));
    return format(" Values: {}.", fmt::join(pairs, ", "));
}

void addProperty(Strings& lines, const om::PropertyDeclaration& property) {
    const bool writable = om::isMarked(property.qualifiers, "Write");
    const char* marks = property.key ? (writable ? " (key, writable)" : " (key)") : writable ? " (writable)" : "";
    lines.insert(
        lines.end(),
        {".TP", format("\\fB{}\\fR, {}{}", property.name, mof::typeText(property.type, property.referenceClass), marks),
         escaped(description(property.qualifiers) + values(property.qualifiers))});
}

void addMethod(Strings& lines, const om::MethodDeclaration& method) {
    lines.insert(lines.end(), {".TP", format("\\fB{}\\fR(), {}", method.name, mof::typeText(method.returnType)),
                               escaped(description(method.qualifiers)), ".RS"});
    for (const om::ParameterDeclaration& parameter : method.parameters) {
        const char* way = !parameter.out ? "in" : parameter.in ? "in, out" : "out";
        lines.insert(lines.end(), {".TP",
                                   format("\\fI{}\\fR, {} ({})", parameter.name,
                                          mof::typeText(parameter.type, parameter.referenceClass), way),
                                   escaped(description(parameter.qualifiers))});
    }
    lines.emplace_back(".RE");
}

/// Names, each once.
struct Names {
    void add(const std::string& name) {
        if (std::find(all.begin(), all.end(), name) == all.end()) all.push_back(name);
    }
    std::string words() const { return format("{}", fmt::join(all, " ")); }
    std::string json() const {
        Strings texts;
        std::transform(all.begin(), all.end(), std::back_inserter(texts), quoted);
        return format("[{}]", fmt::join(texts, ", "));
    }

    Strings all;
};

} // namespace

std::string manualText(const Classes& ours) {
    Strings lines;
    for (const om::ClassDeclaration* declared : ours) {
        lines.insert(lines.end(), {".SS " + declared->name, "Derived from " + declared->superclass + '.',
                                   escaped(description(declared->qualifiers))});
        for (const om::PropertyDeclaration& property : declared->properties) addProperty(lines, property);
        for (const om::MethodDeclaration& method : declared->methods) addMethod(lines, method);
    }
    return format("{}", fmt::join(lines, "\n"));
}

std::string filled(std::string frame, const Classes& ours) {
    Names classes, associations, roles, methods, properties;
    for (const om::ClassDeclaration* declared : ours) {
        (declared->association ? associations : classes).add(declared->name);
        for (const om::MethodDeclaration& method : declared->methods) methods.add(declared->name + '=' + method.name);
        for (const om::PropertyDeclaration& property : declared->properties) {
            properties.add(declared->name + '=' + property.name);
            if (om::elementType(property.type) == CMPI_ref) roles.add(property.name);
        }
    }
    const std::map<std::string, std::string> texts = {
        {"CLASSES", manualText(ours)},          {"CLASS_LIST", classes.json()},
        {"CLASS_WORDS", classes.words()},       {"ASSOCIATION_LIST", associations.json()},
        {"METHOD_WORDS", methods.words()},      {"ASSOCIATION_WORDS", associations.words()},
        {"PROPERTY_WORDS", properties.words()}, {"ROLE_WORDS", roles.words()}};
    for (const auto& [name, text] : texts) frame = replaced(std::move(frame), '@' + name + '@', text);
    return frame;
}

} // namespace compiler
