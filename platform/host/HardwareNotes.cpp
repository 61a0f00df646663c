#include "host/HardwareNotes.h"

#include "common/Text.h"
#include "logger/LogLine.h"

#include <cerrno>

namespace VK::Host {

namespace {

/// Why there is no text; `absence` for a host that simply does not have it.
std::string reason(const Fact& fact, const std::string& absence) {
    if (!fact.placeholder.empty()) return fact.source + " holds a placeholder, " + inQuotes(fact.placeholder);
    if (!fact.problem.empty()) return fact.source + " " + fact.problem;
    switch (fact.error) {
    case ENOENT:
        return absence;
    case EACCES:
    case EPERM:
        return fact.source + " may be read by root alone";
    default:
        return fact.source + " cannot be read (" + errorText(fact.error) + ")";
    }
}

void noteMissing(std::vector<std::string>& notes, const char* what, const Fact& fact) {
    if (!fact) notes.push_back(std::string("no ") + what + ": " + reason(fact, "the host has none"));
}

} // namespace

std::vector<std::string> notesOn(const HardwareFacts& facts) {
    std::vector<std::string> notes;
    if (facts.noTables.error != 0 && facts.problems.empty()) // damage is among the problems
        notes.push_back("no SMBIOS tables: " + reason(facts.noTables, "the firmware provides none (" +
                                                                          facts.noTables.source + " is not there)"));
    notes.insert(notes.end(), facts.problems.begin(), facts.problems.end());
    noteMissing(notes, "UUID", facts.uuid);
    noteMissing(notes, "serial number", facts.serial);
    noteMissing(notes, "manufacturer", facts.manufacturer);
    noteMissing(notes, "model", facts.model);
    if (facts.chassis.empty()) notes.push_back("no chassis: " + reason(facts.noChassis, "the host has none"));
    noteMissing(notes, "primary owner", facts.ownerName);
    return notes;
}

} // namespace VK::Host
