#pragma once

#include <string>
#include <string_view>

namespace VK::Host {

/// An SMBIOS version as it counts, that is with the known misprints mended.
struct SmbiosVersion {
    unsigned int major = 0;
    unsigned int minor = 0;

    bool isAtLeast(unsigned int otherMajor, unsigned int otherMinor) const {
        return major != otherMajor ? major > otherMajor : minor >= otherMinor;
    }
};

/// The 16 bytes of a system's UUID as text, in lower case. From version 2.6 on the first three fields are stored
/// little-endian. Empty unless there are 16 bytes.
std::string uuidFromBytes(std::string_view bytes, SmbiosVersion version);

/// Whether a UUID, in lower case with or without dashes, says nothing: an unset one, or one of a whole product line.
bool isSharedUuid(std::string_view uuid);

/// A UUID that stands as text somewhere, trimmed and in lower case. Empty for other texts and UUIDs that say nothing.
std::string uuidFromText(std::string_view text);

} // namespace VK::Host
