#pragma once

#include "support/TemporaryDirectory.h"

#include <string>
#include <vector>

namespace support {

/// One SMBIOS structure being put together: a formatted area of zeros to fill in, and strings.
class SmbiosStructureImage {
public:
    SmbiosStructureImage(unsigned char type, std::size_t length);

    SmbiosStructureImage& byte(std::size_t offset, unsigned int value);
    SmbiosStructureImage& bytes(std::size_t offset, const std::string& values);
    /// Adds a string and puts its index at the offset. An empty text leaves "not specified".
    SmbiosStructureImage& text(std::size_t offset, const std::string& value);

    std::string image(unsigned int handle) const;

private:
    std::string formatted;
    std::vector<std::string> strings;
};

/// A system structure (type 1) of 0x1B bytes, with the usual fields.
struct SmbiosSystemImage {
    std::string manufacturer, product, version, serial, sku;
    std::string uuid = std::string(16, '\0'); ///< 16 bytes as stored

    SmbiosStructureImage structure() const;
};

/// A chassis structure (type 3) with one contained element record and the SKU string behind it.
struct SmbiosChassisImage {
    unsigned int type = 23;
    std::string manufacturer, version, serial, sku;
    unsigned int bootUpState = 3, powerSupplyState = 3, thermalState = 3;

    SmbiosStructureImage structure() const;
};

/// The entry point and the table as a kernel shows them.
class SmbiosImage {
public:
    enum EntryPointKind { Version3, Version2, Legacy };

    SmbiosImage(unsigned int majorVersion, unsigned int minorVersion, EntryPointKind entryPointKind = Version3)
        : major(majorVersion), minor(minorVersion), kind(entryPointKind) {}

    SmbiosImage& add(const SmbiosStructureImage& structure);
    SmbiosImage& add(const SmbiosSystemImage& system) { return add(system.structure()); }
    SmbiosImage& add(const SmbiosChassisImage& chassis) { return add(chassis.structure()); }
    /// Adds bytes as they are.
    SmbiosImage& addRaw(const std::string& bytes);

    /// With checksums, and the table's length as it is now.
    std::string entryPoint() const;
    /// Without an end marker; `end` is one.
    const std::string& table() const { return bytes; }
    SmbiosImage& end() { return add(SmbiosStructureImage(127, 4)); }

    /// Lays the files out below a directory, as VK_INSTRUMENTATION_ROOT takes it.
    void writeTo(const TemporaryDirectory& directory) const;

private:
    unsigned int major;
    unsigned int minor;
    EntryPointKind kind;
    unsigned int structures = 0;
    std::string bytes;
};

} // namespace support
