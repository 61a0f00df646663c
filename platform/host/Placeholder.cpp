#include "host/Placeholder.h"

#include "common/Text.h"

#include <algorithm>
#include <string>

namespace VK::Host {

namespace {

constexpr std::string_view FILLERS[] = {"default string", "none",    "n/a",   "na",     "null", "(none)",  "unknown",
                                        "undefined",      "invalid", "empty", "o.e.m.", "oem",  "standard"};

constexpr std::string_view FIELD_NAMES[] = {"system manufacturer",  "system product name",
                                            "system serial number", "chassis manufacture",
                                            "chassis manufacturer", "chassis serial number",
                                            "chassis version",      "asset tag",
                                            "no asset tag",         "sku",
                                            "sku number",           "base board serial number"};

constexpr std::string_view COUNTING_SERIALS[] = {"0123456789", "123456789", "1234567890", "9876543210"};

template <std::size_t N>
bool contains(const std::string_view (&list)[N], std::string_view text) {
    return std::find(std::begin(list), std::end(list), text) != std::end(list);
}

/// Trimmed, lower case, each run of blanks one blank.
std::string normalised(std::string_view text) {
    std::string result;
    for (const char c : lowerCase(trimmed(text))) {
        const char each = c == '\t' ? ' ' : c;
        if (each != ' ' || result.back() != ' ') result += each;
    }
    return result;
}

bool startsWith(std::string_view text, std::string_view start) {
    return text.substr(0, start.size()) == start;
}

/// Takes `start` off the text's front.
bool take(std::string_view& text, std::string_view start) {
    if (!startsWith(text, start)) return false;
    text.remove_prefix(start.size());
    return true;
}

/// "to be filled by o.e.m." in all its spellings, also with more behind it.
bool isToBeFilled(std::string text) {
    text.erase(std::remove(text.begin(), text.end(), '.'), text.end());
    std::string_view rest = text;
    if (!take(rest, "to be ")) return false;
    if (!take(rest, "filled") && !take(rest, "set") && !take(rest, "defined")) return false;
    return rest.empty() || startsWith(rest, " by oem") || startsWith(rest, " by odm") || startsWith(rest, " by o e m");
}

bool isNotSomething(std::string_view text) {
    static constexpr std::string_view WORDS[] = {"specified", "available", "applicable", "defined",
                                                 "set",       "present",   "supported"};
    return take(text, "not ") && contains(WORDS, text);
}

bool isFillerCharacters(std::string_view text) {
    if (text.find_first_not_of(".- x") == std::string_view::npos) return true;
    return text.size() > 1 && text.find_first_not_of(text.front()) == std::string_view::npos;
}

} // namespace

bool isPlaceholder(std::string_view text) {
    const std::string plain = normalised(text);
    return isFillerCharacters(plain) || contains(FILLERS, plain) || contains(FIELD_NAMES, plain) ||
           isNotSomething(plain) || isToBeFilled(plain);
}

bool isPlaceholderSerial(std::string_view text) {
    return isPlaceholder(text) || contains(COUNTING_SERIALS, trimmed(text)) || trimmed(text) == "0";
}

} // namespace VK::Host
