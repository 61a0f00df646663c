#include "include/Trace.h"

#include <cxxabi.h>
#include <pthread.h>

#include <charconv>
#include <cstdint>
#include <new>
#include <stdexcept>

namespace VK {
namespace {

/// What the C++ ABI keeps for each thread.
struct ExceptionGlobals {
    const void* caught;
    unsigned int uncaught;
};

/// std::uncaught_exceptions() > 0 without a table of its own for each thread: this is asked at the end of every scope.
bool isUnwinding() {
    return reinterpret_cast<const ExceptionGlobals*>(abi::__cxa_get_globals())->uncaught > 0;
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

/// Hands one line over: to the log channel, then to the trace channel.
void hand(const char* function, const char* file, unsigned int line, const std::string& category, int level,
          const std::string& text) {
    const int lineNumber = static_cast<int>(line);
    try {
        NVLog::NVLogger::logLevelMessage(function, file, lineNumber, category, level, nullptr, 0, 0, text);
        NVLog::NVLogger::traceLevelMessage(function, file, lineNumber, category, level, nullptr, 0, 0, text);
    } catch (...) {
        rethrowFromLogger();
    }
}

void hand(const TraceLines& lines, int level, const std::string& text) {
    hand(lines.function, lines.file, lines.line, lines.category, level, text);
}

void hand(const TracePoint& at, int level, const MessageBuffer& formatted) {
    const LineText text;
    text->assign(formatted.line());
    hand(at.function.data(), at.source.file.data(), at.line, at.source.category, level, *text);
}

const TraceLines& existing(const TraceLines* lines) {
    if (lines == nullptr) throw std::bad_alloc();
    return *lines;
}

std::string lineOf(const TracePoint& at, MessageType type) {
    MessageBuffer buffer;
    return std::string(detail::format(buffer, at.source.file, at.function, at.line, type).line());
}

constexpr std::string_view rule = "==============================================================================";
static_assert(rule.size() == 78);

/// The markers' own lines carry this file's name and lines; the caller's place stands in the text.
void writeMarker(const std::string& logger, const char* marker, unsigned int line, const std::string& text) {
    hand(marker, "Trace", line, logger, DebugLevel, text);
}

void writeRule(const std::string& logger, const char* marker, unsigned int line) {
    const LineText text;
    text->assign(rule);
    writeMarker(logger, marker, line, *text);
}

void writeEntry(const std::string& logger, const std::string& entering) {
    writeRule(logger, "markProviderEntry", __LINE__);
    writeMarker(logger, "markProviderEntry", __LINE__, entering);
}

void writeExit(const std::string& logger, const std::string& exiting) {
    writeMarker(logger, "markProviderExit", __LINE__, exiting);
    writeRule(logger, "markProviderExit", __LINE__);
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

TraceLines::TraceLines(const TracePoint& at, MessageType type)
    : function(at.function.data()), file(at.source.file.data()), category(at.source.category), line(at.line),
      first(lineOf(at, type)), last(type == ENTERING ? lineOf(at, EXITING) : std::string()) {}

const TraceLines* TracePlace::make(const TracePoint& at, MessageType type) noexcept {
    TraceLines* mine = nullptr;
    try {
        mine = new TraceLines(at, type);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
    const TraceLines* others = nullptr;
    // Not a static local's guard, for which the child of a fork in the middle of it would wait forever.
    if (!place.compare_exchange_strong(others, mine, std::memory_order_acq_rel)) {
        delete mine;
        return others;
    }
    Lasting::keep(mine);
    return mine;
}

void markProviderEntry(const std::string& logger, const char* file, const char* function, unsigned int line) {
    writeEntry(logger,
               lineOf({{logger, detail::textOrNull(file)}, detail::textOrNull(function).data(), line}, ENTERING));
}

void markProviderExit(const std::string& logger, const char* file, const char* function, unsigned int line) {
    writeExit(logger, lineOf({{logger, detail::textOrNull(file)}, detail::textOrNull(function).data(), line}, EXITING));
}

void markProviderEntry(const TraceLines* lines) {
    const TraceLines& made = existing(lines);
    writeEntry(made.category, made.first);
}

void markProviderExit(const TraceLines* lines) {
    const TraceLines& made = existing(lines);
    writeExit(made.category, made.last);
}

void traceMethod(const TraceLines* lines, int level) {
    const TraceLines& made = existing(lines);
    hand(made, level, made.first);
}

void traceMessage(const TracePoint& at, const char* message, int level) {
    MessageBuffer buffer;
    hand(at, level, detail::format(buffer, at.source.file, detail::textOrNull(message), at.line, MESSAGE));
}

void traceVariable(const TracePoint& at, const char* name, const char* value, int level) {
    MessageBuffer buffer;
    hand(at, level, detail::formatVariable(buffer, name, at.source.file.data(), at.line, value));
}

void traceVariable(const TracePoint& at, const char* name, unsigned int value, int level) {
    MessageBuffer buffer;
    hand(at, level, detail::formatVariable(buffer, name, at.source.file.data(), at.line, SignedDecimal(value)));
}

void traceDestructor(const TraceLines* lines) {
    swallowing([&] { traceMethod(lines); });
}

TraceScope::TraceScope(const TraceLines* theLines, int entryLevel) : lines(theLines) {
    const TraceLines& made = existing(lines);
    hand(made, entryLevel, made.first);
}

TraceScope::~TraceScope() noexcept(false) {
    swallowing([&] { hand(*lines, DebugLevel, lines->last); });
}

DestructorTraceScope::DestructorTraceScope(const TraceLines* theLines) : lines(theLines) {
    swallowing([&] { traceMethod(lines); });
}

DestructorTraceScope::~DestructorTraceScope() noexcept(false) {
    swallowing([&] {
        const TraceLines& made = existing(lines);
        hand(made, DebugLevel, made.last);
    });
}

void Parameter::addTo(TextBuffer<MessageBuffer::size + 1>& buffer) const {
    char digits[2 * sizeof address]; // as many as an address has
    char* const end = digits + sizeof digits;
    switch (kind) {
    case Text:
        buffer.add(text);
        return;
    case Number:
        buffer.add(std::string_view(digits, std::to_chars(digits, end, number).ptr));
        return;
    case Address:
        if (address != nullptr) buffer.add("0x");
        buffer.add(
            std::string_view(digits, std::to_chars(digits, end, reinterpret_cast<std::uintptr_t>(address), 16).ptr));
    }
}

void ParameterTraceScope::enter(std::initializer_list<Parameter> parameters) {
    TextBuffer<MessageBuffer::size + 1> buffer;
    buffer.start().add(existing(lines).first, detail::parametersList);
    for (const Parameter& parameter : parameters) parameter.addTo(buffer);
    text->assign(buffer.line());
    // A line ends after 511 characters: of one that is cut, the shorter exit line has one more than the entry line.
    const bool isCut = text->size() == MessageBuffer::size;
    if (isCut) text->pop_back();
    hand(*lines, DebugLevel, *text);
    if (isCut) text->push_back(buffer.line().back());
}

ParameterTraceScope::~ParameterTraceScope() noexcept(false) {
    swallowing([&] {
        text->replace(0, lines->first.size(), lines->last);
        hand(*lines, DebugLevel, *text);
    });
}

} // namespace VK
