#pragma once

#include "include/Lasting.h"
#include "include/LineText.h"
#include "include/MessageBuffer.h"
#include "nvlog/NVLogger.h"
#include "nvlog/NVMessageBuffer.h"

#include <atomic>
#include <initializer_list>
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

/// What a line says; selects its format. A value without a name formats as an empty line.
enum MessageType : unsigned int { ENTERING = 0, EXITING = 1, METHOD_INVOKED = 2, MESSAGE = 3 };

/// The levels in use.
enum TraceLevel : int { NoticeLevel = 3000, DebugLevel = 4000, FailureLevel = 6000 };

// --- Formatting. Each function formats into a buffer of its own, one per thread, of 512 bytes that are all cleared
// --- first. The text stays valid until the thread's next call of the same function. The provider's own lines are made
// --- below, without these buffers.

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
MessageBuffer& formatVariable(MessageBuffer& buffer, const char* name, const char* file, unsigned int line,
                              const Value& value) {
    return buffer.start().add("VARIABLE: '", name, "' has Value '", value, "' at line ", SignedDecimal(line), " in ",
                              file);
}

constexpr std::string_view parametersList = ",Parameters List: ";

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
    if (type <= MESSAGE) messageBuffer.add(detail::parametersList, parameters);
    return messageBuffer.finish();
}

inline char* tracepara(const char* file, const char* function, unsigned int line, const char* parameters,
                       MessageType type) {
    return tracepara(detail::textOrNull(file), detail::textOrNull(function), line, parameters, type);
}

/// A variable's value. The name comes first and the file second, unlike above; the value prints before the line.
inline char* trace(const char* variable, const char* file, unsigned int line, const char* value) {
    static thread_local MessageBuffer messageBuffer;
    return detail::formatVariable(messageBuffer, variable, file, line, value).finish();
}

inline char* trace(const char* variable, const char* file, unsigned int line, unsigned int value) {
    static thread_local MessageBuffer messageBuffer;
    return detail::formatVariable(messageBuffer, variable, file, line, SignedDecimal(value)).finish();
}

// --- Handing lines to the logger.

/// Throws again what the logger threw; what is no std::exception becomes one, so that the boundary towards the
/// object manager knows it. To be called where an exception is handled.
[[noreturn]] void rethrowFromLogger();

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

/// The lines of a place that says the same at every call, and what goes to the logger with them.
struct TraceLines : Lasting {
    /// ENTERING stands for that line and the EXITING line; any other type for its own alone.
    TraceLines(const TracePoint& at, MessageType type);

    const char* const function;
    const char* const file;
    const std::string& category;
    const unsigned int line;
    const std::string first;
    const std::string last; ///< the EXITING line
};

/// Where such lines are kept, one static object for each place: they are made when it is first reached, by whichever
/// thread comes first, and handed over as they stand from then on.
class TracePlace {
public:
    /// Null when there is no memory to make them.
    const TraceLines* lines(const TracePoint& at, MessageType type) noexcept {
        const TraceLines* const known = made();
        return known != nullptr ? known : make(at, type);
    }

    const TraceLines* made() const noexcept { return place.load(std::memory_order_acquire); }
    const TraceLines* make(const TracePoint& at, MessageType type) noexcept;

private:
    std::atomic<const TraceLines*> place{nullptr};
};

/// A place of its own for each place where this stands.
#define VK_PLACE()                                                                                                     \
    []() -> VK::TracePlace& {                                                                                          \
        static constinit VK::TracePlace place;                                                                         \
        return place;                                                                                                  \
    }()

// --- The lines of the place where one of these stands, as the functions and scopes below take them: of the function
// --- itself, or under another name. The source is asked for once.

#define VK_TRACE_LINES(type, source, name)                                                                             \
    [&](const char* functionOfPlace) -> const VK::TraceLines* {                                                        \
        static constinit VK::TracePlace placeOfLines;                                                                  \
        const VK::TraceLines* const linesOfPlace = placeOfLines.made();                                                \
        if (__builtin_expect(linesOfPlace != nullptr, true)) return linesOfPlace;                                      \
        return placeOfLines.make(VK::TracePoint(source, functionOfPlace, __LINE__), VK::type);                         \
    }(name)
#define VK_SCOPE(source) VK_TRACE_LINES(ENTERING, source, __func__)
#define VK_SCOPE_OF(source, name) VK_TRACE_LINES(ENTERING, source, name)
#define VK_METHOD(source) VK_TRACE_LINES(METHOD_INVOKED, source, __func__)
#define VK_METHOD_OF(source, name) VK_TRACE_LINES(METHOD_INVOKED, source, name)

/// One line of each kind. Lines of a place that could not be made throw std::bad_alloc.
void traceMethod(const TraceLines* lines, int level = DebugLevel);
void traceMessage(const TracePoint& at, const char* message, int level);
void traceVariable(const TracePoint& at, const char* name, const char* value, int level = DebugLevel);
void traceVariable(const TracePoint& at, const char* name, unsigned int value, int level = DebugLevel);

/// The lines around an operation of the object manager: a rule of 78 "=" and the ENTERING line, the EXITING line and
/// the rule.
void markProviderEntry(const std::string& logger, const char* file, const char* function, unsigned int line);
void markProviderExit(const std::string& logger, const char* file, const char* function, unsigned int line);
void markProviderEntry(const TraceLines* lines);
void markProviderExit(const TraceLines* lines);

// --- Scopes. What the logger throws at a scope's end or in a destructor ends there. A thread that ends in the logger
// --- (it is cancelled, or leaves by pthread_exit) is unwound from there all the same: so these destructors, and those
// --- of classes that trace in theirs, are noexcept(false). While an exception unwinds, a cancellation waits for the
// --- first chance after the line; leaving by pthread_exit ends the process then, as from any C++ destructor.

/// A METHOD line from a destructor.
void traceDestructor(const TraceLines* lines);

/// The entry line now and the exit line when the scope ends, by return or by exception.
class TraceScope {
public:
    explicit TraceScope(const TraceLines* theLines, int entryLevel = DebugLevel);
    ~TraceScope() noexcept(false);
    TraceScope(const TraceScope&) = delete;
    TraceScope& operator=(const TraceScope&) = delete;

private:
    const TraceLines* const lines;
};

/// The same for a destructor: what the logger throws at the entry ends there, too.
class DestructorTraceScope {
public:
    explicit DestructorTraceScope(const TraceLines* theLines);
    ~DestructorTraceScope() noexcept(false);
    DestructorTraceScope(const DestructorTraceScope&) = delete;
    DestructorTraceScope& operator=(const DestructorTraceScope&) = delete;

private:
    const TraceLines* const lines;
};

/// One part of a parameter list: a label or text, a number, or any object's address, never its contents.
class Parameter {
public:
    Parameter(const char* theText) : kind(Text), text(theText) {}
    Parameter(unsigned int theNumber) : kind(Number), number(theNumber) {}
    template <class T>
    Parameter(const T* object) : kind(Address), address(object) {
        static_assert(!std::is_same_v<T, char>, "a text is no object");
    }

    void addTo(TextBuffer<MessageBuffer::size + 1>& buffer) const;

private:
    enum { Text, Number, Address } kind;
    union {
        const char* text;
        unsigned int number;
        const void* address;
    };
};

/// The same with the function's parameters, given as labels and values in turn.
class ParameterTraceScope {
public:
    template <class... Parts>
    explicit ParameterTraceScope(const TraceLines* theLines, const Parts&... parts) : lines(theLines) {
        enter({Parameter(parts)...});
    }
    ~ParameterTraceScope() noexcept(false);
    ParameterTraceScope(const ParameterTraceScope&) = delete;
    ParameterTraceScope& operator=(const ParameterTraceScope&) = delete;

private:
    void enter(std::initializer_list<Parameter> parameters);

    const TraceLines* const lines;
    LineText text;
};

} // namespace VK
