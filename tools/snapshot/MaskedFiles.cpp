#include "tools/snapshot/MaskedFiles.h"

#include "common/Text.h"

#include <algorithm>
#include <iterator>

namespace snapshot {

namespace {

struct KnownFile {
    std::string_view name;
    Content content;
};

// A file that the provider reads and that is not here is masked whole.
constexpr KnownFile knownFiles[] = {
    {"smbios_entry_point", Content::EntryPoint},
    {"DMI", Content::Table},
    {"product_serial", Content::Serial},
    {"chassis_serial", Content::Serial},
    {"serial-number", Content::Serial},
    {"sysinfo", Content::Sysinfo},
    {"product_uuid", Content::Uuid},
    {"vm,uuid", Content::Uuid},
    {"uuid", Content::Uuid},
    {"machine-id", Content::Uuid},
    {"sys_vendor", Content::Plain},
    {"product_name", Content::Plain},
    {"product_version", Content::Plain},
    {"product_sku", Content::Plain},
    {"board_vendor", Content::Plain},
    {"board_name", Content::Plain},
    {"chassis_vendor", Content::Plain},
    {"chassis_type", Content::Plain},
    {"chassis_version", Content::Plain},
    {"model", Content::Plain},
    {"compatible", Content::Plain},
    {"chassis-type", Content::Plain},
    {"machine-info", Content::Plain},
    {"localtime", Content::Plain},
    {"timezone", Content::Plain},
    {"adjtime", Content::Plain},
    {"scheduled", Content::Plain},
    {"ue_count", Content::Plain},
};

/// What a masked line of /proc/sysinfo says.
std::string maskedValue(std::string_view key, const std::string& value, Mask& mask) {
    if (key == "Manufacturer" || key == "Type" || key == "Model") return value; // the same on many machines
    if (key == "Sequence Code") return mask.serial(value);
    if (key.ends_with("UUID")) return mask.uuid(value);
    return key.ends_with("Name") ? mask.name(value) : std::string();
}

std::string maskedLine(std::string_view line, Mask& mask) {
    const std::size_t colon = line.find(':');
    if (colon == std::string_view::npos) return {};
    const std::string_view value = VK::trimmed(line.substr(colon + 1));
    std::string masked(line);
    if (value.empty()) return masked;
    const auto at = static_cast<std::size_t>(value.data() - line.data());
    return masked.replace(at, value.size(), maskedValue(VK::trimmed(line.substr(0, colon)), std::string(value), mask));
}

std::string maskedText(Content content, const std::string& text, Mask& mask) {
    switch (content) {
    case Content::Serial:
        return mask.serial(text);
    case Content::Uuid:
        return mask.uuid(text);
    case Content::Sysinfo:
        return maskedSysinfo(text, mask);
    default:
        return mask.name(mask.everywhere(text));
    }
}

} // namespace

Content contentOf(std::string_view path) {
    const std::string_view name = path.substr(path.rfind('/') + 1);
    const auto* const known = std::find_if(std::begin(knownFiles), std::end(knownFiles),
                                           [name](const KnownFile& file) { return file.name == name; });
    return known != std::end(knownFiles) ? known->content : Content::Unknown;
}

std::string maskedSysinfo(std::string_view text, Mask& mask) {
    std::string masked;
    while (true) {
        const std::size_t end = text.find('\n');
        masked += maskedLine(text.substr(0, end), mask);
        if (end == std::string_view::npos) return masked;
        masked += '\n';
        text.remove_prefix(end + 1);
    }
}

std::string maskedFile(Content content, const std::string& bytes, const std::string& entryPoint, Mask& mask) {
    if (content == Content::EntryPoint) return bytes;
    if (content == Content::Table) return maskedTable(bytes, entryPoint, mask);
    if (content == Content::Plain) return mask.everywhere(bytes);
    const std::size_t length = bytes.find_last_not_of(std::string_view("\n\0", 2)) + 1;
    return maskedText(content, bytes.substr(0, length), mask) + bytes.substr(length);
}

} // namespace snapshot
