#pragma once

#include <map>
#include <string>
#include <string_view>

namespace snapshot {

/// Replaces what tells one machine from another, the same by the same, so that what belongs together still does.
class Mask {
public:
    /// The salt decides what is put for what; nobody who does not know it can find out.
    explicit Mask(std::string saltOfRun) : salt(std::move(saltOfRun)) {}

    /// Digits become digits, letters letters of the same case; the rest stays, and so does what says nothing.
    std::string name(const std::string& text) const;

    /// As a name; what is put for it is put wherever else the serial number stands, too.
    std::string serial(const std::string& text);

    /// A UUID's text with its digits replaced, in its letter case; anything else as a name.
    std::string uuid(const std::string& text) const;

    /// The bytes with the masks put on the serial numbers that were masked before.
    std::string everywhere(std::string bytes) const;

private:
    std::string stream(std::string_view text, std::size_t count, unsigned int turn) const;

    std::string salt;
    std::map<std::string, std::string> replaced;
};

} // namespace snapshot
