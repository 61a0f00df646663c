#include "objectmanager/vkcim/Run.h"

#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/Advice.h"
#include "objectmanager/vkcim/DefaultLibrary.h"
#include "objectmanager/vkcim/Effect.h"
#include "objectmanager/vkcim/FactsOutput.h"
#include "objectmanager/vkcim/HostNotes.h"
#include "objectmanager/vkcim/JsonOutput.h"
#include "objectmanager/vkcim/MetricsOutput.h"
#include "objectmanager/vkcim/MofOutput.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/QuietErrors.h"
#include "objectmanager/vkcim/Repetition.h"
#include "objectmanager/vkcim/Requests.h"
#include "objectmanager/vkcim/SchemaText.h"
#include "objectmanager/vkcim/TextOutput.h"
#include "objectmanager/vkcim/Utf8.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

#include <istream>
#include <ostream>

namespace vkcim {
namespace {

constexpr int answeredError = 1;
constexpr int unusableArguments = 2;
constexpr int unusableLibrary = 3;
constexpr int nothingDone = 4;

void complain(const Streams& streams, const std::string& line) {
    streams.error << wrapped("vkcim: " + shortened(line), streams.messageColumns) << '\n';
}

class Runner {
public:
    Runner(const Arguments& given, const Streams& where)
        : arguments(given), streams(where), schema(om::Schema::builtin()) {}

    int run() {
        switch (arguments.command->action) {
        case Action::Report:
            return isForEngines(arguments.format) ? facts() : report();
        case Action::Classes:
            return show(classesText(schema));
        case Action::Describe:
            return describe();
        default:
            return operation();
        }
    }

private:
    /// What an operation was answered, and what is known of it afterwards.
    struct Outcome {
        Repeated repeated;
        std::string hostProblem;
        std::vector<std::string> unchanged; ///< of a modification: notChanged
    };

    int report() {
        Timing timing;
        std::string problem;
        const auto started = std::chrono::steady_clock::now();
        const Report report = askReport<Report>(timing, [&](const Run& run, const Notes& notes) {
            return makeReport(everythingServed(schema), arguments.nameSpace, arguments.properties, run, [&] {
                problem = hostProblemHere();
                return notes();
            });
        });
        timing.wall = std::chrono::steady_clock::now() - started;
        print(arguments.format == Format::Json  ? jsonText(report, arguments.nameSpace, schema) + '\n'
              : arguments.format == Format::Mof ? mofText(report, arguments.nameSpace, schema)
                                                : plainReport(report, style(arguments.nameSpace)));
        if (!problem.empty()) complain(cannotRead(problem));
        printTiming(timing);
        return written(problem.empty() ? 0 : nothingDone);
    }

    /// For programs that collect from many hosts: one that cannot be read says so in what they collect.
    int facts() {
        Timing timing;
        const auto started = std::chrono::steady_clock::now();
        const Facts facts = askReport<Facts>(timing, [&](const Run& run, const Notes& notes) {
            const auto clock = [&] { return isRemote() ? HostClock() : hostClock(arguments.provider); };
            return gatherFacts(schema, arguments.nameSpace, arguments.properties, run, clock, notes);
        });
        timing.wall = std::chrono::steady_clock::now() - started;
        print(arguments.format == Format::Facts ? factsText(facts, arguments.nameSpace, schema) + '\n'
                                                : metricsText(facts, schema, arguments.withSerials));
        printTiming(timing);
        return written(0);
    }

    int describe() {
        const om::Request request = makeRequest(arguments, schema, streams.input);
        if (const om::ClassDeclaration* declared = schema.find(request.path.className))
            return show(classText(*declared, schema));
        for (const std::string& line : adviceOn(request, CMPI_RC_ERR_INVALID_CLASS, schema)) complain(line);
        return unusableArguments;
    }

    int operation() {
        std::vector<std::string> remarks;
        const om::Request request = makeRequest(arguments, schema, streams.input, &remarks);
        for (const std::string& remark : remarks) complain(remark);
        if (arguments.dryRun) return dryRun(request);
        const Outcome outcome = ask(request);
        const Repeated& repeated = outcome.repeated;
        const std::vector<std::string> missing = lackOf(request, outcome);
        print(answerText(repeated.answer, request, !missing.empty()));
        if (repeated.worst != 0) explain(repeated, request);
        for (const std::string& line : missing) complain(line);
        if (request.fault && !repeated.answer.faulted)
            complain("the fault did not happen, as there were fewer such calls");
        printTiming(repeated.timing);
        return written(repeated.worst != 0 ? answeredError : missing.empty() ? 0 : nothingDone);
    }

    std::string library() const {
        return arguments.library.empty() ? defaultLibrary(programDirectory()) : libraryPath(arguments.library);
    }

    TextStyle style(const std::string& nameSpace) const { return {nameSpace, schema, streams.look}; }

    static std::string cannotRead(const std::string& problem) { return "the host cannot be read: " + problem; }

    bool isRemote() const { return !arguments.remote.url.empty(); }

    /// What the libraries of this host know of it says nothing of another one.
    std::string hostProblemHere() const { return isRemote() ? std::string() : hostProblem(arguments.provider); }

    /// Who answers: a provider's library, or a server.
    class Answering {
    public:
        Answering(const Runner& runner, const std::string& nameSpace) {
            if (runner.isRemote())
                server.emplace(runner.arguments.remote, runner.schema);
            else
                manager.emplace(runner.library(), runner.arguments.provider, nameSpace, runner.schema);
        }

        om::Answer run(const om::Request& request, Nanoseconds* elapsed = nullptr) {
            if (manager) return manager->run(request, elapsed);
            const auto started = std::chrono::steady_clock::now();
            om::Answer answer = server->run(request);
            if (elapsed != nullptr) *elapsed = std::chrono::steady_clock::now() - started;
            return answer;
        }

    private:
        std::optional<om::ObjectManager> manager;
        std::optional<RemoteServer> server;
    };

    // In both, the provider has cleaned up and is unloaded before anything is printed.
    Outcome ask(const om::Request& request) const {
        Answering manager(*this, request.path.nameSpace);
        const LastFailure failure;
        Outcome outcome;
        outcome.repeated = repeatedly([&](Nanoseconds& elapsed) { return manager.run(request, &elapsed); },
                                      arguments.repeat, arguments.threads, arguments.timing);
        if (request.operation == om::Operation::ModifyInstance && outcome.repeated.worst == 0) {
            const std::string reason = failure.text();
            om::Request again;
            again.operation = om::Operation::GetInstance;
            again.path = request.path;
            outcome.unchanged = notChanged(request, manager.run(again), reason, schema);
        }
        outcome.hostProblem = hostProblemHere();
        return outcome;
    }

    using Run = std::function<om::Answer(const om::Request&)>;
    using Notes = std::function<std::vector<std::string>()>;

    template <typename Result, typename Make>
    Result askReport(Timing& timing, const Make& make) const {
        Answering manager(*this, arguments.nameSpace);
        std::optional<QuietErrors> quiet;
        if (!arguments.verbose) quiet.emplace();
        return make([&](const om::Request& request) { return manager.run(request, &timing.runs.emplace_back()); },
                    [&] { return isRemote() ? std::vector<std::string>() : hostNotes(arguments.provider); });
    }

    /// What an operation that was answered with OK did not find or did not do, a line each.
    std::vector<std::string> lackOf(const om::Request& request, const Outcome& outcome) const {
        if (!outcome.hostProblem.empty()) return {cannotRead(outcome.hostProblem)};
        if (outcome.repeated.worst != 0) return {};
        const om::Answer& answer = outcome.repeated.answer;
        const std::string path = qualifiedPathText(request.path, arguments.nameSpace, schema);
        if (request.operation == om::Operation::GetInstance && answer.results.empty())
            return {"no such instance: " + path};
        if (arguments.command->action == Action::Value &&
            plainValues(answer, arguments.member, style(request.path.nameSpace)).empty())
            return {fmt::format("{} of {} has no value", arguments.member, path)};
        return outcome.unchanged;
    }

    std::string answerText(const om::Answer& answer, const om::Request& request, bool lacks) const {
        const std::string& nameSpace = request.path.nameSpace;
        if (arguments.command->action == Action::Value) return plainValues(answer, arguments.member, style(nameSpace));
        if (arguments.format == Format::Json) return jsonText(answer, nameSpace, schema) + '\n';
        if (arguments.format == Format::Mof) return mofText(answer, nameSpace, schema);
        // What was not found or done is said on standard error.
        return lacks && answer.results.empty() ? "" : plainAnswer(answer, style(nameSpace));
    }

    int dryRun(const om::Request& request) const {
        if (isRemote()) throw std::runtime_error("--dry-run does not go with --url");
        const om::ObjectManager manager(library(), arguments.provider, request.path.nameSpace, schema);
        const int shown = show(dryRunText(request));
        const std::string problem = hostProblemHere();
        if (problem.empty()) return shown;
        complain(cannotRead(problem));
        return nothingDone;
    }

    /// While the provider's library is loaded.
    std::string dryRunText(const om::Request& request) const {
        const bool calls = request.operation == om::Operation::InvokeMethod;
        std::string text =
            fmt::format("host      {}\nprovider  {} in {}\npath      {}\n{}\n", hostDescribed(arguments.provider),
                        arguments.provider, library(), qualifiedPathText(request.path, arguments.nameSpace, schema),
                        calls ? "invoke    " + request.method : std::string("modify"));
        for (const auto& [name, value] : request.values)
            text += fmt::format("  {}={}\n", name, valueText(value, {request.path.nameSpace, schema}));
        return text + "Nothing was asked.\n";
    }

    void explain(const Repeated& repeated, const om::Request& request) const {
        const std::string message = repeated.worstMessage ? ": " + *repeated.worstMessage : "";
        complain(fmt::format("{} ({}){}", om::statusName(repeated.worst), repeated.worst, message));
        for (const std::string& line : adviceOn(request, repeated.worst, schema)) complain(line);
    }

    void complain(const std::string& line) const { vkcim::complain(streams, line); }

    void print(const std::string& text) const { streams.output << text << std::flush; }

    int show(const std::string& text) const {
        print(wrapped(text, streams.look.width));
        return written(0);
    }

    void printTiming(const Timing& timing) const {
        if (arguments.timing) streams.error << timingText(timing) << '\n' << std::flush;
    }

    int written(int status) const {
        if (streams.output.good()) return status;
        complain("the answer cannot be written");
        return answeredError;
    }

    const Arguments& arguments;
    const Streams& streams;
    const om::Schema& schema;
};

int failed(const Streams& streams, const std::exception& error, int status) {
    complain(streams, error.what());
    return status;
}

} // namespace

int run(const Arguments& arguments, const Streams& streams) {
    try {
        return Runner(arguments, streams).run();
    } catch (const om::LoadError& error) {
        return failed(streams, error, unusableLibrary);
    } catch (const std::exception& error) {
        return failed(streams, error, unusableArguments);
    }
}

} // namespace vkcim
