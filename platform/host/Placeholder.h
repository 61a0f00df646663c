#pragma once

#include <string_view>

namespace VK::Host {

/// What a text of the firmware is about, where that matters.
enum class FirmwareText {
    Other,
    Model, ///< or a version: real ones can be short numbers that count
    ChassisSku,
};

/// A way to see that a text of the firmware says nothing. All of them stand in Placeholders.inc.
struct PlaceholderRule {
    enum Match {
        Whole,        ///< the letters and digits of the text are those of one of `texts`
        Begin,        ///< they begin like one of `texts`
        FieldName,    ///< one of `texts`, maybe with words for whose it is before it and a short number at its end
        Counting,     ///< four digits or more, each one more, or each one less, than the one before it; 9 and 0 are
                      ///< neighbours; behind 9 or 0 letters may count on. A model or version has eight at least.
        OneCharacter, ///< one character, twice or more often
        NoLetter,     ///< no letter and no digit, or x alone
        ChassisType,  ///< of a chassis' SKU: the name of a chassis type
    };
    Match match;
    unsigned int machines; ///< see Placeholders.inc
    std::string_view reason;
    std::string_view texts;
};

/// The rule by which a text says nothing; null for one that says something. Letter case does not matter, nor do
/// blanks and dots around the text.
const PlaceholderRule* placeholderRule(std::string_view text, FirmwareText kind);

inline bool isPlaceholder(std::string_view text, FirmwareText kind = FirmwareText::Other) {
    return placeholderRule(text, kind) != nullptr;
}

} // namespace VK::Host
