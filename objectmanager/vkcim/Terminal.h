#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace vkcim {

/// What text for people may look like.
struct Look {
    bool colours = false;
    bool boxes = true;     ///< whether lines may be drawn with characters beyond ASCII
    std::size_t width = 0; ///< columns at which lines are broken; 0 breaks none
};

/// What the user's terminal and settings ask of standard output: colours only on a terminal, and only unless the user
/// refused them (https://no-color.org); box drawing only in a UTF-8 locale; lines broken at COLUMNS where it is set,
/// else at a terminal's width.
Look lookOfStandardOutput();

/// The columns at which messages on standard error are broken: those of a terminal, or 0, so that a message in a file
/// stays one line.
std::size_t widthOfMessages();

/// The text with lines that are longer than `width` broken at blanks, or behind commas where a single word is too long.
/// What follows stands below the text of the line's last column, where there are columns, else below its beginning. A
/// word longer than the width stays whole.
std::string wrapped(std::string_view text, std::size_t width);

} // namespace vkcim
