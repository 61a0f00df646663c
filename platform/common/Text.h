#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace VK {

/// The longest text that a property carries, in bytes.
constexpr std::size_t longestText = 256;

/// Without blanks, tabs, line ends and NULs at both ends.
std::string_view trimmed(std::string_view text);

/// The same length, each byte below 0x20 and from 0x7F on being a dot.
std::string printable(std::string_view text);

/// A text of the firmware as properties carry it: trimmed, printable, at most 256 bytes.
std::string cleanText(std::string_view text);

/// A text that an administrator wrote: as above, but what is UTF-8 stays UTF-8.
std::string cleanWrittenText(std::string_view text);

/// ASCII letters in lower case; other bytes stay.
std::string lowerCase(std::string_view text);

/// The text up to the first line end.
std::string_view firstLine(std::string_view text);

/// Takes the next line off the text's front: what stands before its line feed.
std::string_view takeLine(std::string_view& text);

/// A text from outside as part of a log line: printable, in quotes, cut after 64 bytes.
std::string inQuotes(const std::string& text);

} // namespace VK
