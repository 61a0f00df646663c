#pragma once

#include <pugixml.hpp>

#include <limits>
#include <string_view>

/// CIM-XML as it stands in messages. The functions here are pure: bytes to elements, and values to text.
namespace cimxml {

/// More levels of elements than this no message has.
constexpr int deepestElement = 64;

/// More elements than this no request has; each takes far more memory than the text that it stands in.
constexpr int mostElements = 50000;

/// Reads a whole document into `document`. Refused before anything is parsed are texts that are not UTF-8 or hold
/// characters that XML does not have, document types, references to entities other than XML's five, elements nested
/// deeper than `deepestElement`, and more of them than `most`; an answer may have any number. Text of blanks alone
/// is kept where it is all that an element holds. Throws Refusal.
void load(pugi::xml_document& document, std::string_view text, int most = std::numeric_limits<int>::max());

} // namespace cimxml
