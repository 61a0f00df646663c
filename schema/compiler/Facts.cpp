#include "schema/compiler/Facts.h"

#include "objectmanager/model/Characters.h"
#include "objectmanager/mof/MofError.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

#include <algorithm>
#include <map>
#include <regex>
#include <sstream>

namespace compiler {
namespace {

using fmt::format;
using Strings = std::vector<std::string>;

/// A kind of fact: what it is called, and its form.
struct Form {
    const char* what;
    std::regex pattern;
};

const Form classForm{"a class", std::regex(R"((\w+)(?:\s*<\s*(\w+))?(\s+association)?)")};
const Form methodForm{"a method", std::regex(R"((\w+)\s+(\w+)\((.*)\))")};
const Form propertyForm{"a property", std::regex(R"((key\s+)?(\w+)(\s+ref)?\s+(\w+)(\[\])?(?:\s*=\s*(\d+))?)")};
const Form parameterForm{"a parameter", std::regex(R"((in\s+)?(out\s+)?(\w+)(\s+ref)?\s+(\w+)(\[\])?)")};

std::string trimmed(std::string_view text) {
    return std::string(om::trimmed(text));
}

Strings split(const std::string& text, char separator) {
    Strings parts;
    std::istringstream stream(text);
    for (std::string part; std::getline(stream, part, separator);) parts.push_back(part);
    return parts;
}

/// Writes the stub line by line.
class Stub {
public:
    explicit Stub(const std::string& name) : file(name) {}

    void add(const std::string& line) {
        ++number;
        const std::string content = trimmed(line.substr(0, line.find('#')));
        if (content.empty()) return;
        if (line.front() != ' ' && line.front() != '\t') return addClass(content);
        if (names.empty()) throw mof::MofError(file, number, "a property before the first class");
        text += "    " + (content.find('(') == std::string::npos ? property(content) : method(content)) + '\n';
    }

    std::string finished() const { return text + (names.empty() ? "" : "};\n") + '\n'; }

private:
    /// The parts of a fact, the one that the whole pattern stands for first.
    Strings read(const Form& form, const std::string& content) const {
        std::smatch parts;
        if (!std::regex_match(content, parts, form.pattern)) {
            throw mof::MofError(file, number, format("'{}' is not {}", content, form.what));
        }
        return {parts.begin(), parts.end()};
    }

    static std::string feature(const std::string& type, const std::string& ref, const std::string& name,
                               const std::string& array) {
        return format("{}{} {}{}", type, ref.empty() ? "" : " REF", name, array);
    }

    void addClass(const std::string& content) {
        const Strings found = read(classForm, content);
        const std::string &name = found[1], &superclass = found[2];
        if (!names.empty()) text += "};\n\n";
        if (!found[3].empty()) text += "[Association]\n";
        text += format("class {}{}{} {{\n", name, superclass.empty() ? "" : " : ", superclass);
        inherited = names[superclass];
        names[name] = inherited;
        current = name;
    }

    std::string property(const std::string& content) {
        const Strings found = read(propertyForm, content);
        const std::string &name = found[4], &value = found[6];
        Strings marks;
        if (std::find(inherited.begin(), inherited.end(), name) != inherited.end()) {
            marks.push_back(format("Override(\"{}\")", name));
        }
        if (!found[1].empty()) marks.emplace_back("Key");
        names[current].push_back(name);
        return format("{}{}{}{};", marks.empty() ? "" : format("[{}] ", fmt::join(marks, ", ")),
                      feature(found[2], found[3], name, found[5]), value.empty() ? "" : " = ", value);
    }

    std::string method(const std::string& content) const {
        const Strings found = read(methodForm, content);
        Strings parameters;
        for (const std::string& part : split(found[3], ',')) {
            if (trimmed(part).empty()) continue;
            const Strings each = read(parameterForm, trimmed(part));
            parameters.push_back(format("[{}{}] {}", each[1].empty() ? "In(false)" : "In",
                                        each[2].empty() ? "" : ", Out", feature(each[3], each[4], each[5], each[6])));
        }
        return format("{} {}({});", found[1], found[2], fmt::join(parameters, ", "));
    }

    const std::string& file;
    std::size_t number = 0;
    std::string text;
    std::map<std::string, Strings> names; ///< of each class's properties, with those that it inherits
    Strings inherited;
    std::string current;
};

} // namespace

std::string stub(const std::string& text, const std::string& file) {
    Stub made(file);
    for (const std::string& line : split(text, '\n')) made.add(line);
    return made.finished();
}

std::vector<std::string> wordsOf(const std::string& text) {
    Strings words;
    for (const std::string& line : split(text, '\n')) {
        std::istringstream stream(line.substr(0, line.find('#')));
        for (std::string word; stream >> word;) words.push_back(word);
    }
    return words;
}

} // namespace compiler
