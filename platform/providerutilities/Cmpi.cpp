#include "providerutilities/Cmpi.h"

#include "nvlog/NVLogger.h"

#include <stdexcept>

#include <cxxabi.h>

namespace VK::Cmpi {

namespace {

std::string withCode(const std::string& text, const CMPIStatus& status) {
    return text + ", return code " + std::to_string(static_cast<int>(status.rc));
}

std::string noAnswer(const char* what, const CMPIStatus& status) {
    return withCode(std::string("The broker could not tell ") + what, status);
}

void logFailure(const char* function, int line, const std::string& text) {
    try {
        NVLog::NVLogger::logLevelMessage(function, "ProviderUtilities", line, "Norvane.ProviderUtilities", 6000,
                                         nullptr, 0, 0, text);
    } catch (const abi::__forced_unwind&) { // a cancelled thread
        throw;
    } catch (...) { // NOLINT(bugprone-empty-catch): another logger's failure is no reason to fail
    }
}

} // namespace

bool hasValue(const CMPIData& data, const CMPIStatus& status) {
    return succeeded(status) && (data.state & (CMPI_nullValue | CMPI_notFound | CMPI_badValue)) == 0;
}

void requireTold(const CMPIStatus& status, const char* what) {
    if (succeeded(status) || isAbsent(status)) return;
    throw std::runtime_error(noAnswer(what, status));
}

void noteUntold(const char* function, int line, const char* what, const CMPIStatus& status) {
    if (!succeeded(status) && !isAbsent(status)) logFailure(function, line, noAnswer(what, status));
}

const char* textOf(const CMPIString* string, CMPIStatus& status) {
    status = freshStatus();
    if (!hasSlot(string, &CMPIStringFT::getCharPtr)) return nullptr;
    const char* const text = string->ft->getCharPtr(string, &status);
    return succeeded(status) ? text : nullptr;
}

const char* textOf(const CMPIString* string) {
    CMPIStatus status;
    return textOf(string, status);
}

const char* textOf(const CMPIData& data, CMPIStatus& status) {
    status = freshStatus();
    switch (data.type) {
    case CMPI_string:
        return textOf(data.value.string, status);
    case CMPI_chars:
        return data.value.chars;
    default:
        return nullptr;
    }
}

const char* textOf(const CMPIData& data) {
    CMPIStatus status;
    return textOf(data, status);
}

const CMPIValue* asChars(const char* text) {
    return reinterpret_cast<const CMPIValue*>(text);
}

bool refused(const char* function, int line, const std::string& what, const char* name, const CMPIStatus& status) {
    logFailure(function, line,
               withCode("The broker refused " + what + " " + (name != nullptr ? name : "(null)"), status));
    return false;
}

} // namespace VK::Cmpi
