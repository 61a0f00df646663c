#pragma once

#include "host/Placeholder.h"

#include <initializer_list>
#include <string>

namespace VK::Host {

/// A text that the host tells and the file that it stands in, or why there is none.
struct Fact {
    std::string text;    ///< empty when the host does not tell it
    std::string source;  ///< the file; without text the one to blame
    int error = 0;       ///< without text: ENOENT the host has no such thing, EACCES we may not see it
    std::string useless; ///< without text: a placeholder that stands in its place
    std::string problem; ///< without text: what is wrong with the file, which might tell it otherwise; "is missing"

    explicit operator bool() const { return !text.empty(); }
};

/// No text, because the file cannot be read, or (ENOENT) does not have it.
Fact missing(const std::string& source, int error);

/// A text that stands in a file; none where it is empty or a placeholder.
Fact told(const std::string& source, const std::string& text, FirmwareText kind = FirmwareText::Other);

/// The first that tells something; else the miss that tells most of the reason.
Fact firstOf(std::initializer_list<Fact> facts);

} // namespace VK::Host
