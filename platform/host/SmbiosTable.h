#pragma once

#include "host/Uuid.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace VK::Host {

/// What the entry point says of the table.
struct SmbiosEntryPoint {
    SmbiosVersion version;
    std::size_t tableLength = 0; ///< the most that the table can be long
    std::string problem;         ///< why the entry point cannot be used; empty when it can
};

/// Reads an entry point of any of the three kinds (`_SM3_`, `_SM_`, `_DMI_`), checksums included.
SmbiosEntryPoint parseSmbiosEntryPoint(std::string_view bytes);

/// One structure of a table. Refers to the table's bytes.
class SmbiosStructure {
public:
    SmbiosStructure(std::string_view formattedArea, std::string_view stringArea)
        : formatted(formattedArea), strings(stringArea) {}

    unsigned int type() const { return *byteAt(0); }
    /// A field; nothing where the structure is too short to have it.
    std::optional<unsigned int> byteAt(std::size_t offset) const;
    std::optional<std::string_view> bytesAt(std::size_t offset, std::size_t length) const;

    /// All but type and handle: what stands behind the header, and the strings.
    using Contents = std::pair<std::string_view, std::string_view>;
    Contents contents() const { return {formatted.substr(header), strings}; }

    /// The string whose index stands at the offset, as it is there. Empty where there is no such field, its index
    /// is 0 ("not specified") or there are fewer strings; `badIndexes` counts the last kind.
    std::string_view stringAt(std::size_t offset, std::size_t& badIndexes) const;

private:
    static constexpr std::size_t header = 4; ///< type, length and handle

    std::string_view formatted;
    std::string_view strings; ///< each with its NUL
};

/// Steps through a table's structures, each step checked: never a byte outside the table is looked at.
class SmbiosTable {
public:
    explicit SmbiosTable(std::string_view bytes) : rest(bytes), size(bytes.size()) {}

    /// The next structure; nothing at the end (type 127, only zeros, no more bytes) or where the table is broken.
    std::optional<SmbiosStructure> next();

    /// Where and how the table is broken; empty as long as it is not.
    const std::string& problem() const { return broken; }

private:
    std::nullopt_t stop(const char* problem);

    std::string_view rest;
    std::size_t size;
    std::string broken;
};

} // namespace VK::Host
