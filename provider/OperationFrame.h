#pragma once

#include "provider/BaseServerProvider.h"
#include "provider/Look.h"

#include "vk/ClassId.h"

#include <algorithm>
#include <cstddef>
#include <exception>
#include <iterator>

namespace VK::BaseServerProvider {

/// Runs a step whose exceptions end here: what a logger throws never reaches the object manager. A thread's end does.
template <class Step>
void contained(Step step) {
    try {
        step();
    } catch (const std::exception&) { // NOLINT(bugprone-empty-catch): there is nowhere left to log it
    }
}

/// The row of a dispatch table that a class has; null where it has none.
template <class Row, std::size_t N>
const Row* findRow(const Row (&rows)[N], unsigned short classId) {
    const Row* const row =
        std::find_if(std::begin(rows), std::end(rows), [&](const Row& one) { return one.classId == ClassId{classId}; });
    return row != std::end(rows) ? row : nullptr;
}

/// One operation of the object manager: the markers around it, its lines, and the boundary that no exception crosses
/// (std::exception, that is: nothing of ours throws anything else).
class OperationFrame {
public:
    explicit OperationFrame(TracePlace& thePlace, const char* theFunction = __builtin_FUNCTION())
        : place(thePlace), function(theFunction) {}

    /// The place of a line of this operation.
    TracePoint here(unsigned int line = __builtin_LINE()) const { return {frameSource, function, line}; }

    void traceClassId(unsigned short classId, unsigned int line = __builtin_LINE()) const {
        traceVariable(here(line), "classId", classId);
    }

    /// Runs `work` behind the entry marker. An exception is logged and handed to `onException`.
    template <class Work, class OnException>
    void run(Work work, OnException onException, unsigned int line = __builtin_LINE()) const {
        try {
            markProviderEntry(place.lines(here(line), ENTERING));
            work();
        } catch (const std::exception& exception) {
            contained([&] { traceMessage(here(line), exception.what(), NoticeLevel); });
            onException(exception);
        }
    }

    /// The same for an operation that ends with the exit marker and swallows exceptions: the status stays as it stood,
    /// on purpose.
    template <class Work>
    CMPIStatus runMarked(Work work, unsigned int line = __builtin_LINE()) const {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        run([&] { withinLook([&] { work(status); }); }, [](const std::exception&) {}, line);
        contained([&] { markProviderExit(place.lines(here(line), ENTERING)); });
        return status;
    }

    /// An operation that is not offered: one METHOD line, no markers.
    CMPIStatus notSupported(unsigned int line = __builtin_LINE()) const {
        contained([&] { traceMethod(place.lines(here(line), METHOD_INVOKED)); });
        return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    }

private:
    TracePlace& place; ///< of the lines around the operation
    const char* const function;
};

/// An operation's answer on its way to the object manager. A part that is refused is logged in the operation's name;
/// the rest is handed over all the same.
class Answer {
public:
    Answer(const OperationFrame& theFrame, const CMPIResult* theResult) : frame(theFrame), result(theResult) {}

    /// Hand over one element of an adapter; a null, which stands for nothing, is not handed over.
    void add(const CMPIObjectPath* path);
    void add(const CMPIInstance* instance);
    /// Hands over a method's return value.
    void add(unsigned int returnValue);
    /// Says that the answer is whole. Some object managers refuse that where nothing was found: no line then.
    void close();

private:
    void note(const CMPIStatus& status) const;

    const OperationFrame& frame;
    const CMPIResult* const result;
    bool empty = true; ///< nothing was handed over
};

} // namespace VK::BaseServerProvider
