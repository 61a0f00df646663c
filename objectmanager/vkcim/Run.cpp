#include "objectmanager/vkcim/Run.h"

#include "objectmanager/vkcim/DefaultLibrary.h"
#include "objectmanager/vkcim/HostNotes.h"
#include "objectmanager/vkcim/JsonOutput.h"
#include "objectmanager/vkcim/MofOutput.h"
#include "objectmanager/vkcim/Names.h"
#include "objectmanager/vkcim/Repetition.h"
#include "objectmanager/vkcim/Requests.h"
#include "objectmanager/vkcim/Suggestion.h"
#include "objectmanager/vkcim/TextOutput.h"
#include "objectmanager/vkcim/Utf8.h"

#include <istream>
#include <ostream>

namespace vkcim {
namespace {

constexpr int answeredError = 1;
constexpr int unusableArguments = 2;
constexpr int unusableLibrary = 3;

bool isAssociation(om::Operation operation) {
    return operation == om::Operation::Associators || operation == om::Operation::AssociatorNames;
}

class Runner {
public:
    Runner(const Arguments& given, const Streams& where)
        : arguments(given), streams(where), schema(om::Schema::builtin()) {}

    int report() {
        Timing timing;
        const auto started = std::chrono::steady_clock::now();
        const Report report = askEverything(timing);
        timing.wall = std::chrono::steady_clock::now() - started;
        print(arguments.format == Format::Json  ? jsonText(report, arguments.nameSpace, schema) + '\n'
              : arguments.format == Format::Mof ? mofText(report, arguments.nameSpace, schema)
                                                : plainReport(report, {arguments.nameSpace, schema, streams.colours}));
        printTiming(timing);
        return written(0);
    }

    int operation() {
        const om::Request request = makeRequest(arguments, schema, streams.input);
        const Repeated repeated = ask(request);
        const std::string& nameSpace = request.path.nameSpace;
        print(arguments.format == Format::Json  ? jsonText(repeated.answer, nameSpace, schema) + '\n'
              : arguments.format == Format::Mof ? mofText(repeated.answer, nameSpace, schema)
                                                : plainAnswer(repeated.answer, {nameSpace, schema, streams.colours}));
        if (repeated.worst != 0) complain(repeated, request);
        if (request.fault && !repeated.answer.faulted)
            streams.error << "vkcim: the fault did not happen, as there were fewer such calls\n";
        printTiming(repeated.timing);
        return written(repeated.worst == 0 ? 0 : answeredError);
    }

private:
    std::string library() const {
        return arguments.library.empty() ? defaultLibrary(programDirectory()) : libraryPath(arguments.library);
    }

    // In both, the provider has cleaned up and is unloaded before anything is printed.
    Repeated ask(const om::Request& request) const {
        om::ObjectManager manager(library(), arguments.provider, request.path.nameSpace, schema);
        return repeatedly([&](Nanoseconds& elapsed) { return manager.run(request, &elapsed); }, arguments.repeat,
                          arguments.threads, arguments.timing);
    }

    Report askEverything(Timing& timing) const {
        om::ObjectManager manager(library(), arguments.provider, arguments.nameSpace, schema);
        return makeReport(
            schema, arguments.nameSpace, arguments.properties,
            [&](const om::Request& request) { return manager.run(request, &timing.runs.emplace_back()); },
            [&] { return hostNotes(arguments.provider); });
    }

    void complain(const Repeated& repeated, const om::Request& request) const {
        streams.error << "vkcim: " << statusName(repeated.worst) << " (" << repeated.worst << ')';
        if (repeated.worstMessage) streams.error << ": " << printable(*repeated.worstMessage);
        streams.error << '\n';
        if (repeated.worst != CMPI_RC_ERR_INVALID_CLASS) return;
        for (const std::string& className : {request.path.className, request.assocClass.value_or("")}) {
            if (className.empty() || schema.find(className)) continue;
            const auto nearest = nearestClass(className, schema);
            streams.error << "vkcim: there is no class " << printable(className)
                          << (nearest ? "; did you mean " + *nearest + "?\n" : " in the schema\n");
            return;
        }
        if (isAssociation(request.operation) && !request.assocClass)
            streams.error << "vkcim: the association's class may have to be named: --assoc-class\n";
    }

    void print(const std::string& text) const { streams.output << text << std::flush; }

    void printTiming(const Timing& timing) const {
        if (arguments.timing) streams.error << timingText(timing) << '\n' << std::flush;
    }

    int written(int status) const {
        if (streams.output.good()) return status;
        streams.error << "vkcim: the answer cannot be written\n";
        return answeredError;
    }

    const Arguments& arguments;
    const Streams& streams;
    const om::Schema& schema;
};

} // namespace

int run(const Arguments& arguments, const Streams& streams) {
    try {
        Runner runner(arguments, streams);
        return arguments.operation ? runner.operation() : runner.report();
    } catch (const om::LoadError& error) {
        streams.error << "vkcim: " << printable(error.what()) << '\n';
        return unusableLibrary;
    } catch (const std::exception& error) {
        streams.error << "vkcim: " << printable(error.what()) << '\n';
        return unusableArguments;
    }
}

} // namespace vkcim
