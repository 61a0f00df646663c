#pragma once

#include <map>
#include <string>
#include <string_view>

namespace snapshot {

/// The bytes that a UUID's digits stand for, in their order; dashes between them are passed over.
std::string bytesOfDigits(std::string_view digits);

/// Replaces what identifies a machine. Equal texts are replaced equally, so that what belongs together still does.
class Mask {
public:
    /// The salt decides the replacements; without it nobody can find out what was replaced.
    explicit Mask(std::string saltOfRun) : salt(std::move(saltOfRun)) {}

    /// Digits become digits, and letters become letters of the same case. The rest stays, and so do placeholders.
    std::string name(const std::string& text) const;

    /// As a name; the same replacement is put wherever else the serial number stands.
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
