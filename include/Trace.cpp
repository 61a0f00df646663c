#include "include/Trace.h"

#include <cxxabi.h>
#include <pthread.h>

#include <stdexcept>

namespace VK {
namespace {

/// What the C++ ABI keeps for each thread.
struct ExceptionGlobals {
    const void* caught;
    unsigned int uncaught;
};

/// std::uncaught_exceptions() > 0 at a third of its price: this is asked at the end of every scope.
bool isUnwinding() {
    static thread_local const ExceptionGlobals* globals = nullptr;
    if (globals == nullptr) globals = reinterpret_cast<const ExceptionGlobals*>(abi::__cxa_get_globals());
    return globals->uncaught > 0;
}

/// Puts off a cancellation.
class CancellationPutOff {
public:
    CancellationPutOff() { pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, &before); }
    ~CancellationPutOff() { pthread_setcancelstate(before, nullptr); }
    CancellationPutOff(const CancellationPutOff&) = delete;
    CancellationPutOff& operator=(const CancellationPutOff&) = delete;

private:
    int before = PTHREAD_CANCEL_ENABLE;
};

/// Runs a step whose exceptions must go nowhere: it stands in a destructor. Only a thread's end goes on, since the C
/// library ends the process when it is swallowed. It is caught by a reference to no object, which is how the
/// compiler's runtime has it.
template <class Step>
__attribute__((no_sanitize("null"))) void swallowingAllButTheEnd(Step step) {
    try {
        step();
    } catch (const abi::__forced_unwind&) {
        throw;
    } catch (...) { // NOLINT(bugprone-empty-catch): a line that the logger refused is all that is lost
    }
}

/// The same while an exception unwinds: nothing else may leave a destructor then, so that a cancellation waits.
template <class Step>
__attribute__((noinline, cold)) void swallowingInUnwinding(Step step) {
    const CancellationPutOff putOff;
    swallowingAllButTheEnd(step);
}

template <class Step>
void swallowing(Step step) {
    if (__builtin_expect(isUnwinding(), false)) return swallowingInUnwinding(step);
    swallowingAllButTheEnd(step);
}

void hand(const TracePoint& at, int level, const char* text) {
    logAndTrace(at.function.data(), at.source.file.data(), at.line, at.source.category, level, text);
}

void writeLine(const TracePoint& at, int level, MessageType type) {
    hand(at, level, trace(at.source.file, at.function, at.line, type));
}

void writeLine(const TracePoint& at, const char* parameters, MessageType type) {
    hand(at, DebugLevel, tracepara(at.source.file, at.function, at.line, parameters, type));
}

constexpr char rule[] = "==============================================================================";
static_assert(sizeof rule == 78 + 1);

/// The markers' own lines carry this file's name and lines; the caller's place stands in the text.
void writeMarker(const std::string& logger, const char* marker, unsigned int line, const char* text) {
    logAndTrace(marker, "Trace", line, logger, DebugLevel, text);
}

} // namespace

__attribute__((no_sanitize("null"))) void rethrowFromLogger() {
    try {
        throw;
    } catch (const std::exception&) {
        throw;
    } catch (const abi::__forced_unwind&) { // a cancelled thread
        throw;
    } catch (...) {
        throw std::runtime_error("The logger failed");
    }
}

void logAndTrace(const char* function, const char* file, unsigned int line, const std::string& category, int level,
                 const char* text) {
    try {
        NVLog::NVMessageBuffer buffer;
        const std::string& message = NVLog::NVMessageBuffer::str(buffer << text);
        const int lineNumber = static_cast<int>(line);
        NVLog::NVLogger::logLevelMessage(function, file, lineNumber, category, level, nullptr, 0, 0, message);
        NVLog::NVLogger::traceLevelMessage(function, file, lineNumber, category, level, nullptr, 0, 0, message);
    } catch (...) {
        rethrowFromLogger();
    }
}

void markProviderEntry(const std::string& logger, const char* file, const char* function, unsigned int line) {
    writeMarker(logger, __func__, __LINE__, rule);
    writeMarker(logger, __func__, __LINE__, trace(file, function, line, ENTERING));
}

void markProviderExit(const std::string& logger, const char* file, const char* function, unsigned int line) {
    writeMarker(logger, __func__, __LINE__, trace(file, function, line, EXITING));
    writeMarker(logger, __func__, __LINE__, rule);
}

void traceMethod(const TracePoint& at, int level) {
    writeLine(at, level, METHOD_INVOKED);
}

void traceMessage(const TracePoint& at, const char* message, int level) {
    hand(at, level, trace(at.source.file, detail::textOrNull(message), at.line, MESSAGE));
}

void traceVariable(const TracePoint& at, const char* name, const char* value, int level) {
    hand(at, level, trace(name, at.source.file.data(), at.line, value));
}

void traceVariable(const TracePoint& at, const char* name, unsigned int value, int level) {
    hand(at, level, trace(name, at.source.file.data(), at.line, value));
}

void traceDestructor(const TracePoint& at) {
    swallowing([&] { writeLine(at, DebugLevel, METHOD_INVOKED); });
}

TraceScope::TraceScope(const TracePoint& point, int entryLevel) : at(point) {
    writeLine(at, entryLevel, ENTERING);
}

TraceScope::~TraceScope() noexcept(false) {
    swallowing([&] { writeLine(at, DebugLevel, EXITING); });
}

DestructorTraceScope::DestructorTraceScope(const TracePoint& point) : at(point) {
    swallowing([&] { writeLine(at, DebugLevel, ENTERING); });
}

DestructorTraceScope::~DestructorTraceScope() noexcept(false) {
    swallowing([&] { writeLine(at, DebugLevel, EXITING); });
}

void ParameterTraceScope::enter() {
    writeLine(at, parameters, ENTERING);
}

ParameterTraceScope::~ParameterTraceScope() noexcept(false) {
    swallowing([&] { writeLine(at, parameters, EXITING); });
}

} // namespace VK
