#include "host/Placeholder.h"

#include "common/Text.h"
#include "host/ChassisType.h"

#include <algorithm>
#include <string>

namespace VK::Host {

namespace {

constexpr unsigned int notCounted = 0;

constexpr PlaceholderRule rules[] = {
#define PLACEHOLDER(MATCH, MACHINES, REASON, TEXTS) {PlaceholderRule::MATCH, MACHINES, REASON, TEXTS},
#include "host/Placeholders.inc"
};

#define FIELD_WORDS(role, WORDS) constexpr std::string_view FIELD_WORDS_##role = WORDS;
#include "host/Placeholders.inc"

/// A text as the rules compare it.
struct Compared {
    std::string plain;   ///< lower case, without blanks and dots around it
    std::string letters; ///< its letters and digits alone
};

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

bool isLetterOrDigit(char c) {
    return isDigit(c) || (c >= 'a' && c <= 'z');
}

std::string lettersOf(std::string_view text) {
    std::string letters;
    std::copy_if(text.begin(), text.end(), std::back_inserter(letters), isLetterOrDigit);
    return letters;
}

Compared compared(std::string_view text) {
    constexpr std::string_view around = " \t.";
    const std::string_view whole = trimmed(text);
    const std::size_t begin = std::min(whole.find_first_not_of(around), whole.size());
    const std::string_view inner = whole.substr(begin, whole.find_last_not_of(around) + 1 - begin);
    std::string plain = lowerCase(inner);
    std::string letters = lettersOf(plain);
    return {std::move(plain), std::move(letters)};
}

/// Takes a text of the table, which is in lower case, off the front of letters and digits.
bool take(std::string_view& letters, std::string_view text) {
    std::string_view rest = letters;
    for (const char c : text) {
        if (!isLetterOrDigit(c)) continue;
        if (rest.empty() || rest.front() != c) return false;
        rest.remove_prefix(1);
    }
    letters = rest;
    return true;
}

/// Whether the test holds for one of the texts that are separated by |.
template <typename Test>
bool anyOf(std::string_view texts, Test test) {
    while (true) {
        const std::size_t end = texts.find('|');
        if (test(texts.substr(0, end))) return true;
        if (end == std::string_view::npos) return false;
        texts.remove_prefix(end + 1);
    }
}

bool isOneOf(std::string_view texts, std::string_view letters) {
    return anyOf(texts, [letters](std::string_view text) {
        std::string_view rest = letters;
        return take(rest, text) && rest.empty();
    });
}

bool beginsWithOneOf(std::string_view texts, std::string_view letters) {
    return anyOf(texts, [letters](std::string_view text) {
        std::string_view rest = letters;
        return take(rest, text);
    });
}

/// Without a number that stands directly behind a letter (SKU0). A longer one may be somebody's, and so may one that
/// stands apart (SKU-27).
std::string_view withoutNumber(std::string_view plain) {
    constexpr std::size_t longest = 3;
    while (!plain.empty() && !isLetterOrDigit(plain.back())) plain.remove_suffix(1);
    std::string_view word = plain;
    while (!word.empty() && isDigit(word.back())) word.remove_suffix(1);
    const bool numbered = !word.empty() && isLetterOrDigit(word.back()) && plain.size() - word.size() <= longest;
    return numbered ? word : plain;
}

/// Any number of words for whose the field is, then the field.
bool isFieldName(std::string_view fields, std::string_view letters, bool isOwned = false) {
    if (isOneOf(fields, letters) || (isOwned && isOneOf(FIELD_WORDS_OwnedField, letters))) return true;
    return anyOf(FIELD_WORDS_Owner, [fields, letters](std::string_view owner) {
        std::string_view rest = letters;
        return take(rest, owner) && isFieldName(fields, rest, true);
    });
}

bool isCounting(std::string_view plain) {
    const std::size_t digits = std::min(plain.find_first_not_of("0123456789"), plain.size());
    if (digits < 4) return false;
    const auto step = [plain](std::size_t i) { return (plain[i] - plain[i - 1] + 10) % 10; };
    if (step(1) != 1 && step(1) != 9) return false;
    for (std::size_t i = 2; i < digits; ++i)
        if (step(i) != step(1)) return false;
    if (digits == plain.size()) return true;
    // As hexadecimal digits do: 0123456789ABCDEF.
    constexpr std::string_view alphabet = "abcdefghijklmnopqrstuvwxyz";
    const char last = plain[digits - 1];
    return step(1) == 1 && (last == '9' || last == '0') &&
           plain.substr(digits) == alphabet.substr(0, plain.size() - digits);
}

bool isChassisTypeName(std::string_view letters) {
    for (ChassisType type = 1; type <= lastChassisType; ++type)
        if (lettersOf(lowerCase(chassisTypeName(type))) == letters) return true;
    return false;
}

bool matches(const PlaceholderRule& rule, const Compared& text, FirmwareText kind) {
    constexpr std::size_t shortestCountingModel = 8;
    switch (rule.match) {
    case PlaceholderRule::Whole:
        return isOneOf(rule.texts, text.letters);
    case PlaceholderRule::Begin:
        return beginsWithOneOf(rule.texts, text.letters);
    case PlaceholderRule::FieldName:
        return isFieldName(rule.texts, lettersOf(withoutNumber(text.plain)));
    case PlaceholderRule::Counting:
        return isCounting(text.plain) && (kind != FirmwareText::Model || text.plain.size() >= shortestCountingModel);
    case PlaceholderRule::OneCharacter:
        return text.plain.size() > 1 && text.plain.find_first_not_of(text.plain.front()) == std::string::npos;
    case PlaceholderRule::NoLetter:
        return text.letters.find_first_not_of('x') == std::string::npos;
    case PlaceholderRule::ChassisType:
        return kind == FirmwareText::ChassisSku && isChassisTypeName(text.letters);
    }
    return false;
}

} // namespace

const PlaceholderRule* placeholderRule(std::string_view text, FirmwareText kind) {
    const Compared each = compared(text);
    const auto* const rule = std::find_if(std::begin(rules), std::end(rules),
                                          [&](const PlaceholderRule& one) { return matches(one, each, kind); });
    return rule != std::end(rules) ? rule : nullptr;
}

} // namespace VK::Host
