#include "instrumentation/HostNotes.h"

#include "instrumentation/Log.h"

#include <cerrno>

namespace VK {
namespace Inside {

namespace {

std::string tablesNote(int error) {
    const std::string what = "no SMBIOS tables: ";
    switch (error) {
    case ENOENT:
        return what + "the firmware provides none (/sys/firmware/dmi/tables is not there)";
    case EACCES:
    case EPERM:
        return what + "/sys/firmware/dmi/tables may be read by root alone";
    default:
        return what + "/sys/firmware/dmi/tables cannot be read (" + errorText(error) + ")";
    }
}

std::string reason(const Fact& fact) {
    if (!fact.useless.empty()) return fact.source + " holds a placeholder, " + inQuotes(fact.useless);
    switch (fact.error) {
    case ENOENT:
        return "the host does not tell it";
    case EACCES:
    case EPERM:
        return fact.source + " may be read by root alone";
    default:
        return fact.source + ": " + errorText(fact.error);
    }
}

void noteMissing(std::vector<std::string>& notes, const char* what, const Fact& fact) {
    if (!fact) notes.push_back(std::string("no ") + what + ": " + reason(fact));
}

} // namespace

std::vector<std::string> notesOn(const HardwareFacts& facts) {
    std::vector<std::string> notes;
    if (facts.tablesError != 0) notes.push_back(tablesNote(facts.tablesError));
    notes.insert(notes.end(), facts.problems.begin(), facts.problems.end());
    noteMissing(notes, "UUID", facts.uuid);
    noteMissing(notes, "serial number", facts.serial);
    noteMissing(notes, "manufacturer", facts.manufacturer);
    noteMissing(notes, "model", facts.model);
    if (facts.chassis.empty()) notes.push_back("no chassis: the host does not tell of one");
    noteMissing(notes, "primary owner", facts.ownerName);
    return notes;
}

} // namespace Inside
} // namespace VK
