#pragma once

#include "include/MessageBuffer.h"
#include "nvlog/NVLogger.h"
#include "nvlog/NVMessageBuffer.h"

#include <ostream>
#include <string>
#include <string_view>
#include <type_traits>

namespace NVLog {

/// Inserts any object's address, never its contents. Characters stay with the buffer's own insertions.
template <class T>
std::ostream& operator<<(NVMessageBuffer& buffer, const T* pointer) {
    static_assert(!std::is_same_v<T, char>, "texts are inserted by the buffer itself");
    std::ostream& stream = buffer;
    return stream << static_cast<const void*>(pointer);
}

} // namespace NVLog

namespace VK {

/// What a line tells; selects its format. A value without a name formats as an empty line.
enum MessageType : unsigned int { ENTERING = 0, EXITING = 1, METHOD_INVOKED = 2, MESSAGE = 3 };

/// The levels in use.
enum TraceLevel : int { NoticeLevel = 3000, DebugLevel = 4000, FailureLevel = 6000 };

// --- Formatting. Each function formats into a buffer of its own, one per thread, of 512 bytes that are all cleared
// --- first. The text stays valid until the thread's next call of the same function.

namespace detail {

inline MessageBuffer& format(MessageBuffer& buffer, std::string_view file, std::string_view function, unsigned int line,
                             MessageType type) {
    buffer.start();
    const SignedDecimal number(line);
    switch (type) {
    case ENTERING:
        return buffer.add("ENTERING: ", function, "() in ", file, " [Line: ", number, "]");
    case EXITING:
        return buffer.add("EXITING: ", function, "() in ", file, " [Line: ", number, "]");
    case METHOD_INVOKED:
        return buffer.add("METHOD: ", function, "() was invoked in ", file, " [Line: ", number, "]");
    case MESSAGE: // the second argument is the message and stands last
        return buffer.add("MESSAGE [File: ", file, ", Line: ", number, "]: ", function);
    }
    return buffer;
}

template <class Value>
char* formatVariable(MessageBuffer& buffer, const char* name, const char* file, unsigned int line, const Value& value) {
    buffer.start().add("VARIABLE: '", name, "' has Value '", value, "' at line ", SignedDecimal(line), " in ", file);
    return buffer.finish();
}

/// A text as it is printed.
inline std::string_view textOrNull(const char* text) {
    return text != nullptr ? text : "(null)";
}

} // namespace detail

/// The line of `type` for a function (for MESSAGE: a message text) in a file.
inline char* trace(std::string_view file, std::string_view function, unsigned int line, MessageType type) {
    static thread_local MessageBuffer messageBuffer;
    return detail::format(messageBuffer, file, function, line, type).finish();
}

inline char* trace(const char* file, const char* function, unsigned int line, MessageType type) {
    return trace(detail::textOrNull(file), detail::textOrNull(function), line, type);
}

/// The same, followed by a list of parameters.
inline char* tracepara(std::string_view file, std::string_view function, unsigned int line, const char* parameters,
                       MessageType type) {
    static thread_local MessageBuffer messageBuffer;
    detail::format(messageBuffer, file, function, line, type);
    if (type <= MESSAGE) messageBuffer.add(",Parameters List: ", parameters);
    return messageBuffer.finish();
}

inline char* tracepara(const char* file, const char* function, unsigned int line, const char* parameters,
                       MessageType type) {
    return tracepara(detail::textOrNull(file), detail::textOrNull(function), line, parameters, type);
}

/// A variable's value. The name comes first and the file second, unlike above; the value prints before the line.
inline char* trace(const char* variable, const char* file, unsigned int line, const char* value) {
    static thread_local MessageBuffer messageBuffer;
    return detail::formatVariable(messageBuffer, variable, file, line, value);
}

inline char* trace(const char* variable, const char* file, unsigned int line, unsigned int value) {
    static thread_local MessageBuffer messageBuffer;
    return detail::formatVariable(messageBuffer, variable, file, line, SignedDecimal(value));
}

// --- Handing lines to the logger.

/// Throws on what the logger threw: anything that is not a std::exception as one, so that the boundary towards the
/// object manager knows it. To be called where an exception is handled.
[[noreturn]] void rethrowFromLogger();

/// Hands one line over: to the log channel, then to the trace channel. What the logger throws propagates as above.
void logAndTrace(const char* function, const char* file, unsigned int line, const std::string& category, int level,
                 const char* text);

/// The lines around an operation of the object manager: a rule of 78 "=" and the ENTERING line, the EXITING line and
/// the rule.
void markProviderEntry(const std::string& logger, const char* file, const char* function, unsigned int line);
void markProviderExit(const std::string& logger, const char* file, const char* function, unsigned int line);

/// Whose lines they are: a source file's logger category and its bare name.
struct TraceSource {
    const std::string& category;
    std::string_view file; ///< ends in a zero byte
};

/// A place in a source file; converts from the file's source, standing where the conversion stands.
struct TracePoint {
    TracePoint(const TraceSource& theSource, const char* theFunction = __builtin_FUNCTION(),
               unsigned int theLine = __builtin_LINE())
        : source(theSource), function(theFunction), line(theLine) {}

    const TraceSource& source;
    std::string_view function; ///< ends in a zero byte; its length is known when the place is compiled
    unsigned int line;
};

/// One line of each kind.
void traceMethod(const TracePoint& at, int level = DebugLevel);
void traceMessage(const TracePoint& at, const char* message, int level);
void traceVariable(const TracePoint& at, const char* name, const char* value, int level = DebugLevel);
void traceVariable(const TracePoint& at, const char* name, unsigned int value, int level = DebugLevel);

// --- Scopes. What the logger throws at a scope's end or in a destructor ends there. A thread that ends in the logger
// --- (it is cancelled, or leaves by pthread_exit) is unwound from there all the same: so these destructors, and those
// --- of classes that trace in theirs, are noexcept(false). While an exception unwinds, a cancellation waits for the
// --- first chance after the line; leaving by pthread_exit ends the process then, as from any C++ destructor.

/// A METHOD line from a destructor.
void traceDestructor(const TracePoint& at);

/// The entry line now and the exit line when the scope ends, by return or by exception.
class TraceScope {
public:
    explicit TraceScope(const TracePoint& point, int entryLevel = DebugLevel);
    ~TraceScope() noexcept(false);
    TraceScope(const TraceScope&) = delete;
    TraceScope& operator=(const TraceScope&) = delete;

private:
    const TracePoint at;
};

/// The same for a destructor: what the logger throws at the entry ends there, too.
class DestructorTraceScope {
public:
    explicit DestructorTraceScope(const TracePoint& point);
    ~DestructorTraceScope() noexcept(false);
    DestructorTraceScope(const DestructorTraceScope&) = delete;
    DestructorTraceScope& operator=(const DestructorTraceScope&) = delete;

private:
    const TracePoint at;
};

/// The same with the function's parameters, given as labels and values in turn.
class ParameterTraceScope {
public:
    template <class... Parts>
    explicit ParameterTraceScope(const TracePoint& point, const Parts&... parts) try : at(point) {
        (void(buffer << parts), ...);
        parameters = NVLog::NVMessageBuffer::str(buffer).c_str();
        enter();
    } catch (...) {
        rethrowFromLogger();
    }
    ~ParameterTraceScope() noexcept(false);
    ParameterTraceScope(const ParameterTraceScope&) = delete;
    ParameterTraceScope& operator=(const ParameterTraceScope&) = delete;

private:
    void enter();

    const TracePoint at;
    NVLog::NVMessageBuffer buffer;
    const char* parameters = "";
};

} // namespace VK
