#pragma once

#include "vk/CmpiSlots.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <optional>
#include <string>

/// What every use of a broker needs: statuses, slots that may be missing, texts. Slots are called by themselves,
/// because the macros differ between the standard's versions.
namespace VK::Cmpi {

/// A status to hand to a slot; not every broker writes it.
constexpr CMPIStatus freshStatus() {
    return {CMPI_RC_OK, nullptr};
}

constexpr bool succeeded(const CMPIStatus& status) {
    return status.rc == CMPI_RC_OK;
}

/// Whether the broker made an object. A null is a failure, also where the status says OK: it becomes a failure then.
template <typename Object>
bool isMade(const Object* object, CMPIStatus& status) {
    if (object == nullptr && succeeded(status)) status.rc = CMPI_RC_ERR_FAILED;
    return succeeded(status);
}

/// Some brokers count a class's keys that the path does not have, and say so when asked for them.
constexpr bool isAbsent(const CMPIStatus& status) {
    return status.rc == CMPI_RC_ERR_NO_SUCH_PROPERTY || status.rc == CMPI_RC_ERR_NOT_FOUND;
}

/// Throws std::runtime_error for a status that is neither success nor absence: the broker could not say `what`, so
/// that nobody takes it for missing.
void requireTold(const CMPIStatus& status, const char* what);

/// Whether an answer holds a value.
bool hasValue(const CMPIData& data, const CMPIStatus& status);

/// A string's text, valid as long as the string; null when it has none, or when `status` says failure.
const char* textOf(const CMPIString* string, CMPIStatus& status);
const char* textOf(const CMPIString* string);

/// A value's text when it is a text; null otherwise, or when `status` says failure.
const char* textOf(const CMPIData& data, CMPIStatus& status);
const char* textOf(const CMPIData& data);

/// How a text is handed to a slot with the type CMPI_chars: as itself, not as a value that points to it.
const CMPIValue* asChars(const char* text);

/// Logs at level 6000 that the broker could not say `what`, where that is taken for its absence. Nothing for a status
/// that says success or absence.
void noteUntold(const char* function, int line, const char* what, const CMPIStatus& status);

/// Logs at level 6000 that the broker refused something, and is false.
bool refused(const char* function, int line, const std::string& what, const char* name, const CMPIStatus& status);

} // namespace VK::Cmpi
