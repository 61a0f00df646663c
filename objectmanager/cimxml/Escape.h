#pragma once

#include <string>
#include <string_view>

namespace cimxml {

/// Appends a text as an element's content, or as an attribute's value between double quotes. What is not UTF-8, and
/// each character that XML cannot carry, becomes U+FFFD. A carriage return is written as a reference, since a parser
/// would make a line feed of it; in an attribute line feeds and tabulators are, too.
void appendText(std::string& out, std::string_view text);
void appendAttribute(std::string& out, std::string_view text);

} // namespace cimxml
