#include "host/HardwareNotes.h"

#include "common/Text.h"
#include "logger/LogLine.h"

#include <cerrno>

namespace VK::Host {

namespace {

std::string whyNoTables(int error) {
    switch (error) {
    case ENOENT:
        return "the firmware provides none (/sys/firmware/dmi/tables is not there)";
    case EACCES:
    case EPERM:
        return "/sys/firmware/dmi/tables may be read by root alone";
    default:
        return "/sys/firmware/dmi/tables cannot be read (" + errorText(error) + ")";
    }
}

/// Tables that are there but hidden from us may well tell of one.
std::string whyNoChassis(int tablesError) {
    return tablesError == 0 || tablesError == ENOENT ? "the host does not tell of one" : whyNoTables(tablesError);
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
    if (facts.tablesError != 0) notes.push_back("no SMBIOS tables: " + whyNoTables(facts.tablesError));
    notes.insert(notes.end(), facts.problems.begin(), facts.problems.end());
    noteMissing(notes, "UUID", facts.uuid);
    noteMissing(notes, "serial number", facts.serial);
    noteMissing(notes, "manufacturer", facts.manufacturer);
    noteMissing(notes, "model", facts.model);
    if (facts.chassis.empty()) notes.push_back("no chassis: " + whyNoChassis(facts.tablesError));
    noteMissing(notes, "primary owner", facts.ownerName);
    return notes;
}

} // namespace VK::Host
