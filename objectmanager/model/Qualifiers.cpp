#include "objectmanager/model/Qualifiers.h"

#include "objectmanager/model/Names.h"

#include <algorithm>
#include <charconv>
#include <limits>

namespace om {

namespace {

/// Reads an end of a range; one that is left out leaves the number as it is.
template <class Number>
bool readEnd(std::string_view text, Number& number) {
    const char* const end = text.data() + text.size();
    return text.empty() || std::from_chars(text.data(), end, number).ptr == end;
}

/// Whether an entry of a ValueMap covers the number: `5`, or a range such as `5..9`, `..9` and `5..`.
template <class Number>
bool covers(std::string_view entry, Number number) {
    const std::size_t dots = entry.find("..");
    if (dots == std::string_view::npos) return entry == std::to_string(number);
    Number low = std::numeric_limits<Number>::min();
    Number high = std::numeric_limits<Number>::max();
    const bool isRange = readEnd(entry.substr(0, dots), low) && readEnd(entry.substr(dots + 2), high);
    return isRange && low <= number && number <= high;
}

bool covers(std::string_view entry, const Value& value) {
    if (const auto* number = std::get_if<std::uint64_t>(&value.data)) return covers(entry, *number);
    const auto* number = std::get_if<std::int64_t>(&value.data);
    return number != nullptr && covers(entry, *number);
}

/// The numbers of a ValueMap with their words.
class Map {
public:
    explicit Map(const Qualifiers& qualifiers)
        : entries(textsOf(qualifiers, "ValueMap")), words(textsOf(qualifiers, "Values")) {
        entries.resize(std::min(entries.size(), words.size()));
    }

    std::string_view wordFor(const Value& number) const {
        const auto found =
            std::find_if(entries.begin(), entries.end(), [&](std::string_view entry) { return covers(entry, number); });
        return found == entries.end() ? std::string_view() : words[static_cast<std::size_t>(found - entries.begin())];
    }

private:
    std::vector<std::string_view> entries;
    std::vector<std::string_view> words;
};

} // namespace

Value qualifierValue(bool value) {
    return {CMPI_boolean, value};
}

Value qualifierValue(const char* text) {
    return {CMPI_string, std::string(text)};
}

Value qualifierValue(std::initializer_list<const char*> texts) {
    std::vector<Value> elements;
    for (const char* text : texts) elements.push_back(qualifierValue(text));
    return {CMPI_stringA, std::move(elements)};
}

bool isMarked(const Qualifiers& qualifiers, std::string_view name) {
    const Value* value = findValue(qualifiers, name);
    const bool* flag = value != nullptr ? std::get_if<bool>(&value->data) : nullptr;
    return flag != nullptr && *flag;
}

std::string_view textOf(const Qualifiers& qualifiers, std::string_view name) {
    const Value* value = findValue(qualifiers, name);
    const auto* text = value != nullptr ? std::get_if<std::string>(&value->data) : nullptr;
    return text != nullptr ? std::string_view(*text) : std::string_view();
}

std::vector<std::string_view> textsOf(const Qualifiers& qualifiers, std::string_view name) {
    std::vector<std::string_view> texts;
    const Value* value = findValue(qualifiers, name);
    const auto* elements = value != nullptr ? std::get_if<std::vector<Value>>(&value->data) : nullptr;
    if (elements == nullptr) return texts;
    for (const Value& element : *elements)
        if (const auto* text = std::get_if<std::string>(&element.data)) texts.push_back(*text);
    return texts;
}

std::vector<std::string_view> wordsFor(const Qualifiers& qualifiers, const Value& value) {
    const Map map(qualifiers);
    std::vector<std::string_view> words;
    if (const auto* elements = std::get_if<std::vector<Value>>(&value.data))
        for (const Value& element : *elements) words.push_back(map.wordFor(element));
    else
        words.push_back(map.wordFor(value));
    if (std::all_of(words.begin(), words.end(), [](std::string_view word) { return word.empty(); })) words.clear();
    return words;
}

} // namespace om
