#pragma once

#include "host/Placeholder.h"

#include <initializer_list>
#include <string>

namespace VK::Host {

/// A text of the host and the file that holds it, or why there is none.
struct Fact {
    std::string text;        ///< empty when the host has none
    std::string source;      ///< the file; without text the one to blame
    int error = 0;           ///< without text: ENOENT the host has no such thing, EACCES we may not see it
    std::string placeholder; ///< without text: a placeholder that stands in its place
    std::string problem;     ///< without text: what is wrong with the file, which might hold it otherwise; "is missing"

    explicit operator bool() const { return !text.empty(); }
};

/// No text, because the file cannot be read, or (ENOENT) does not have it.
Fact missing(const std::string& source, int error);

/// A text that stands in a file; none where it is empty or a placeholder.
Fact factOf(const std::string& source, const std::string& text, FirmwareText kind = FirmwareText::Other);

/// The first that has a text; else the miss that says most about the reason.
Fact firstOf(std::initializer_list<Fact> facts);

} // namespace VK::Host
