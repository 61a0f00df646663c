#pragma once

#include "tools/snapshot/Mask.h"

#include <string>
#include <string_view>

namespace snapshot {

/// What in a file identifies a machine, in the order in which files are to be masked: serial numbers first,
/// since they may stand in the others.
enum class Content { EntryPoint, Table, Serial, Sysinfo, Uuid, Plain, Unknown };

/// What the file of that name holds. One that is not known may hold anything.
Content contentOf(std::string_view path);

/// The bytes of a file, masked. `entryPoint` is that of the tables.
std::string maskedFile(Content content, const std::string& bytes, const std::string& entryPoint, Mask& mask);

/// The SMBIOS tables, masked. Their length, their structures and every offset stay, and so do the entry point's
/// checksums.
std::string maskedTable(const std::string& table, std::string_view entryPoint, Mask& mask);

/// The text of /proc/sysinfo, masked; of lines that may hold anything their names alone are kept.
std::string maskedSysinfo(std::string_view text, Mask& mask);

} // namespace snapshot
